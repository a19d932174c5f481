#include "Qvz_MGTPageGui.h"

#include "Qvz_MGTWizPage.h"
#include "Qvz_WizMain.h"
#include "Wg_Wizard.h"

#include <QComboBox>
#include <QRegularExpression>
#include <QRegularExpressionValidator>

void Qvz_MGTPageGui::LEValidator::Setup(QLineEdit* lineEdit, const char* pattern,
                                        const Port::StringBase& message) {
    m_pLineEdit = lineEdit;
    m_message = message;
    if (!lineEdit)
        return;
    const QValidator* old = lineEdit->validator();
    lineEdit->setValidator(
        new QRegularExpressionValidator(QRegularExpression(QString::fromUtf8(pattern)), lineEdit));
    // Pages that set their entries up again on every activation must not
    // pile up validators.
    if (old && old->parent() == lineEdit)
        delete old;
}

Qvz_MGTPageGui::Qvz_MGTPageGui(Qvz_MGTWizPage* page, QWidget* parent, int entryCount,
                               const Port::StringBase& helpKey)
    : Wg_WizardPage(parent), m_entries(entryCount > 0 ? entryCount : 0), m_pBasePage(page),
      m_helpKey(helpKey) {}

Qvz_MGTPageGui::~Qvz_MGTPageGui() = default;

const Qvz_MGTPageGui::LEValidator& Qvz_MGTPageGui::Entry(int index) const {
    static const LEValidator none;
    return index >= 0 && index < EntryCount() ? m_entries[index] : none;
}

void Qvz_MGTPageGui::UpdateData(bool save) {
    if (save)
        WidgetsToData();
    else
        DataToWidgets();
}

void Qvz_MGTPageGui::onActive() {
    m_active = false;
    ReadPage();
    UpdateControls();
    m_active = true;
    EnableMoreInfo();
}

bool Qvz_MGTPageGui::onBack() {
    WidgetsToData();
    if (!WritePage())
        return false;
    return Wg_WizardPage::onBack();
}

bool Qvz_MGTPageGui::onNext() {
    if (!CheckEntries())
        return false;
    WidgetsToData();
    if (!WritePage())
        return false;
    return Wg_WizardPage::onNext();
}

bool Qvz_MGTPageGui::onFinish() {
    WidgetsToData();
    if (!WritePage())
        return true;
    return Wg_WizardPage::onFinish();
}

void Qvz_MGTPageGui::onMoreInfo() {
    if (m_pBasePage)
        m_pBasePage->InvokeMoreInfo(m_helpKey);
}

void Qvz_MGTPageGui::SetPageForm(const QString& title, QWidget* form) {
    setPageName(title);
    setPageWidget(form);
}

void Qvz_MGTPageGui::SetupEntry(int index, QLineEdit* lineEdit, const char* pattern,
                                const Port::StringBase& message) {
    if (index >= 0 && index < EntryCount())
        m_entries[index].Setup(lineEdit, pattern, message);
}

bool Qvz_MGTPageGui::CheckEntries() {
    for (const LEValidator& e : m_entries) {
        QLineEdit* le = e.m_pLineEdit;
        if (!le || !le->isEnabled() || le->hasAcceptableInput())
            continue;
        if (pageWidget() && !le->isVisibleTo(pageWidget()))
            continue;
        if (m_pBasePage)
            m_pBasePage->IssueMessage(e.m_message, false, false, false);
        le->setFocus();
        return false;
    }
    return true;
}

void Qvz_MGTPageGui::FillComboBox(QComboBox* combo, const Qvz_Attribute* attribute) {
    if (!combo)
        return;
    combo->clear();
    if (!attribute)
        return;
    for (const Port::StringBase& v : attribute->GetLegalValues().Items())
        combo->addItem(v.ToQString());
}

void Qvz_MGTPageGui::ReadComboBox(const QComboBox* combo, Port::StringBase& field) {
    if (combo && combo->currentIndex() >= 0)
        field = Port::StringBase::FromQString(combo->currentText());
}

Qvz_Block* Qvz_MGTPageGui::ActiveBlock() const {
    return m_pBasePage && m_pBasePage->m_pWizData ? m_pBasePage->m_pWizData->GetActiveBlock()
                                                  : nullptr;
}

void Qvz_MGTPageGui::EnableMoreInfo() {
    // The dialog is absent when a test drives the controller on its own.
    Qvz_WizMain* main = m_pBasePage ? m_pBasePage->m_pWizMain : nullptr;
    if (main && main->m_pWizard)
        main->m_pWizard->enableMoreInfo(true);
}

void Qvz_MGTPageGui::ApplyAttrRow(const Qvz_Attribute* attr, bool on,
                                  std::initializer_list<QWidget*> widgets) {
    for (QWidget* w : widgets) {
        if (!w)
            continue;
        w->setVisible(attr != nullptr);
        if (attr)
            w->setEnabled(on && attr->IsEditable());
    }
}

void Qvz_MGTPageGui::EnableAll(std::initializer_list<QWidget*> widgets, bool on) {
    for (QWidget* w : widgets)
        w->setEnabled(on);
}

void Qvz_MGTPageGui::ShowAll(std::initializer_list<QWidget*> widgets, bool on) {
    for (QWidget* w : widgets)
        w->setVisible(on);
}

Port::StringBase Qvz_MGTPageGui::EntryText(const QLineEdit* edit) {
    return Port::StringBase(edit->text().toLatin1().toStdString());
}

bool Qvz_MGTPageGui::IsEditable(const Qvz_Attribute* attr) {
    return attr && attr->IsEditable();
}
