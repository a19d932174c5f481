#pragma once
// The last page of the wizard: what the run has made, as rich text to read
// and as plain text to copy.

#include "Wg_WizardPage.h"

class QLabel;
class QPushButton;
class QTextBrowser;

class Wg_SummaryPage : public Wg_WizardPage {
    Q_OBJECT
public:
    explicit Wg_SummaryPage(QWidget* parent);

    // html is shown; plainText is what Copy puts on the clipboard.
    void setSummary(const QString& html, const QString& plainText);
    QString summaryText() const { return m_plain; }

public slots:
    void copyToClipboard();

private:
    QTextBrowser* m_view = nullptr;
    QPushButton* m_copy = nullptr;
    QLabel* m_copied = nullptr;
    QString m_plain;
};
