#include "Qvz_PlaceholderGui.h"

#include <QLabel>

Qvz_PlaceholderGui::Qvz_PlaceholderGui(const QString& title, QWidget* parent)
    : Wg_WizardPage(parent) {
    setPageName(title);
    auto* label = new QLabel(title, parent);
    label->setObjectName("placeholderLabel");
    setPageWidget(label);
}
