#pragma once
// The Receiver Comma Detect Setup form: the designer form's controls, public
// as the controller and the page set them directly.

#include "ui_Qvz_MGTRCDWidget.h"

#include <QDialog>

class Qvz_MGTRCDWidget : public QDialog, public Ui::Qvz_MGTRCDWidget {
    Q_OBJECT
public:
    explicit Qvz_MGTRCDWidget(QWidget* parent = nullptr, const char* name = nullptr,
                              bool modal = false, Qt::WindowFlags fl = {});
    ~Qvz_MGTRCDWidget() override;

    // Sets the texts again and refills cbAlign with its designed items.
    void languageChange();

private:
    int m_designedAlignItems = 0;
};
