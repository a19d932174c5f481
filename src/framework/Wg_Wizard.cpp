#include "Wg_Wizard.h"

#include <QHBoxLayout>
#include <QPushButton>
#include <QStackedWidget>
#include <QVBoxLayout>

Wg_Wizard::Wg_Wizard(QWidget* parent) : QDialog(parent) {
    setObjectName("Wg_Wizard");
    auto* layout = new QVBoxLayout(this);
    m_stack = new QStackedWidget(this);
    m_stack->setObjectName("pageStack");
    layout->addWidget(m_stack, 1);
    auto* buttons = new QHBoxLayout;
    m_moreInfo = new QPushButton(tr("More Info"), this);
    m_moreInfo->setObjectName("buttonMoreInfo");
    m_moreInfo->setEnabled(false);
    buttons->addWidget(m_moreInfo);
    buttons->addStretch(1);
    layout->addLayout(buttons);
}

Wg_Wizard::~Wg_Wizard() = default;

bool Wg_Wizard::addPage(Wg_WizardPage* page) {
    if (!page)
        return false;
    m_pages.append({page, true});
    if (QWidget* w = page->pageWidget())
        m_stack->addWidget(w);
    return true;
}

void Wg_Wizard::enablePage(const QString& pageName, bool enable) {
    for (auto& e : m_pages)
        if (e.page->pageName() == pageName)
            e.enabled = enable;
}

bool Wg_Wizard::isPageEnabled(const QString& pageName) const {
    for (const auto& e : m_pages)
        if (e.page->pageName() == pageName)
            return e.enabled;
    return false;
}

void Wg_Wizard::enableMoreInfo(bool enable) {
    m_moreInfo->setEnabled(enable);
}

Wg_WizardPage* Wg_Wizard::page(int i) const {
    return i >= 0 && i < m_pages.size() ? m_pages[i].page : nullptr;
}

Wg_WizardPage* Wg_Wizard::findPage(const QString& pageName) const {
    for (const auto& e : m_pages)
        if (e.page->pageName() == pageName)
            return e.page;
    return nullptr;
}
