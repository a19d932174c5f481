#pragma once
// Form of the GT11 placement dialog: two columns of eighteen locations.

#include "ui_Qvz_MGTRCBConfig11DialogBase.h"

#include <QDialog>

class Qvz_MGTRCBConfig11DialogBase : public QDialog, public Ui::Qvz_MGTRCBConfig11DialogBase {
    Q_OBJECT
public:
    explicit Qvz_MGTRCBConfig11DialogBase(QWidget* parent = nullptr, const char* name = nullptr,
                                          bool modal = false, Qt::WindowFlags fl = {});
    ~Qvz_MGTRCBConfig11DialogBase() override;

    // Sets the designed texts again.
    void languageChange();
};
