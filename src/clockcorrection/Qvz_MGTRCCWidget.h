#pragma once
// The Receiver Clock Correction Setup form: the designer form's controls,
// public as the controller and the page set them directly.

#include "ui_Qvz_MGTRCCWidget.h"

#include <QDialog>

class Qvz_MGTRCCWidget : public QDialog, public Ui::Qvz_MGTRCCWidget {
    Q_OBJECT
public:
    explicit Qvz_MGTRCCWidget(QWidget* parent = nullptr, const char* name = nullptr,
                              bool modal = false, Qt::WindowFlags fl = {});
    ~Qvz_MGTRCCWidget() override;

    // Sets the texts again; the length list goes back to its placeholder item.
    void languageChange();

public slots:
    virtual void test();
};
