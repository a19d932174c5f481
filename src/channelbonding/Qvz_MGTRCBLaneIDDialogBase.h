#pragma once
// Form of the LANE_ID dialog: 24 entries and a spare pair the dialog hides.

#include "ui_Qvz_MGTRCBLaneIDDialogBase.h"

#include <QDialog>

class Qvz_MGTRCBLaneIDDialogBase : public QDialog, public Ui::Qvz_MGTRCBLaneIDDialogBase {
    Q_OBJECT
public:
    explicit Qvz_MGTRCBLaneIDDialogBase(QWidget* parent = nullptr, const char* name = nullptr,
                                        bool modal = false, Qt::WindowFlags fl = {});
    ~Qvz_MGTRCBLaneIDDialogBase() override;

    // Sets the designed texts again.
    void languageChange();
};
