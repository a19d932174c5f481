#pragma once
// The General Setup form: the designer form's controls, public as the
// controller sets them directly.

#include "ui_GeneralSetupWidget.h"

#include <QWidget>

class GeneralSetupWidget : public QWidget, public Ui::GeneralSetupWidget {
    Q_OBJECT
public:
    explicit GeneralSetupWidget(QWidget* parent = nullptr, const char* name = nullptr,
                                Qt::WindowFlags fl = {});
    ~GeneralSetupWidget() override;

public slots:
    // Sets the texts again.
    virtual void languageChange();
};
