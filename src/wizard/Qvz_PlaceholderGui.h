#pragma once
// A plain controller for pages whose own form has not been built yet.

#include "Wg_WizardPage.h"

class Qvz_PlaceholderGui : public Wg_WizardPage {
    Q_OBJECT
public:
    Qvz_PlaceholderGui(const QString& title, QWidget* parent);
};
