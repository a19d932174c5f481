#include "Wg_SummaryPage.h"

#include <QApplication>
#include <QClipboard>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QTextBrowser>
#include <QVBoxLayout>

Wg_SummaryPage::Wg_SummaryPage(QWidget* parent) : Wg_WizardPage(parent) {
    setPageName("Summary");
    auto* form = new QWidget(parent);
    form->setObjectName("summaryForm");
    auto* layout = new QVBoxLayout(form);
    layout->setContentsMargins(0, 0, 0, 0);
    auto* intro = new QLabel(tr("Finish writes these settings into the design.  Go back to "
                                "change them."),
                             form);
    intro->setWordWrap(true);
    layout->addWidget(intro);
    m_view = new QTextBrowser(form);
    m_view->setObjectName("summaryText");
    m_view->setOpenLinks(false);
    layout->addWidget(m_view, 1);
    auto* row = new QHBoxLayout;
    m_copied = new QLabel(form);
    m_copied->setObjectName("summaryCopied");
    row->addWidget(m_copied, 1);
    m_copy = new QPushButton(tr("Copy as Text"), form);
    m_copy->setObjectName("buttonCopySummary");
    m_copy->setAutoDefault(false);
    row->addWidget(m_copy);
    layout->addLayout(row);
    connect(m_copy, &QPushButton::clicked, this, &Wg_SummaryPage::copyToClipboard);
    setPageWidget(form);
}

void Wg_SummaryPage::setSummary(const QString& html, const QString& plainText) {
    m_plain = plainText;
    m_view->setHtml(html);
    m_copied->clear();
}

void Wg_SummaryPage::copyToClipboard() {
    if (QClipboard* clipboard = QGuiApplication::clipboard()) {
        clipboard->setText(m_plain);
        m_copied->setText(tr("Copied to the clipboard."));
    }
}
