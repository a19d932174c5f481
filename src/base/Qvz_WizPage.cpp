#include "Qvz_WizPage.h"

#include "Qvz_WizMain.h"

#include <QComboBox>

Qvz_WizPage::Qvz_WizPage(Qvz_WizMain* main)
    : m_pWizData(main ? main->GetWizData() : nullptr), m_pWizMain(main) {}

Qvz_WizPage::~Qvz_WizPage() = default;

void Qvz_WizPage::IssueMessage(const Port::StringBase& text, bool f1, bool f2, bool f3) {
    if (m_pWizMain)
        m_pWizMain->IssueMessage(text, f1, f2, f3);
}

void Qvz_WizPage::InvokeMoreInfo(const Port::StringBase& key) {
    if (m_pWizMain)
        m_pWizMain->InvokeMoreInfo(key);
}

bool Qvz_WizPage::SetComboBoxText(QComboBox* combo, const Port::StringBase& text) {
    const int i = GetComboBoxIndex(combo, text);
    if (i < 0)
        return false;
    combo->setCurrentIndex(i);
    return true;
}

int Qvz_WizPage::GetComboBoxIndex(QComboBox* combo, const Port::StringBase& text) {
    if (!combo)
        return -1;
    const QString t = text.ToQString();
    for (int i = 0; i < combo->count(); ++i)
        if (combo->itemText(i) == t)
            return i;
    return -1;
}
