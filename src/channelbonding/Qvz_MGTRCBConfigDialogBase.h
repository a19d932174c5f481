#pragma once
// Form of the placement dialog of GT and GT10: two rows of twelve locations.

#include "ui_Qvz_MGTRCBConfigDialogBase.h"

#include <QDialog>

class Qvz_MGTRCBConfigDialogBase : public QDialog, public Ui::Qvz_MGTRCBConfigDialogBase {
    Q_OBJECT
public:
    explicit Qvz_MGTRCBConfigDialogBase(QWidget* parent = nullptr, const char* name = nullptr,
                                        bool modal = false, Qt::WindowFlags fl = {});
    ~Qvz_MGTRCBConfigDialogBase() override;

    // Sets the designed texts again.
    void languageChange();
};
