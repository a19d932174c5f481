#include "Wg_WizardPage.h"

Wg_WizardPage::Wg_WizardPage(QWidget* parent) : QObject(parent), m_parent(parent) {}

Wg_WizardPage::~Wg_WizardPage() {
    // The form may already be gone with the dialog's widget tree.
    delete m_widget.data();
}

void Wg_WizardPage::setPageWidget(QWidget* widget) {
    if (m_widget == widget)
        return;
    delete m_widget.data();
    m_widget = widget;
}
