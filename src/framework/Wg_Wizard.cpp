#include "Wg_Wizard.h"

#include <QFont>
#include <QFrame>
#include <QHBoxLayout>
#include <QLabel>
#include <QListWidget>
#include <QPushButton>
#include <QScrollArea>
#include <QStackedWidget>
#include <QStyle>
#include <QVBoxLayout>

#include <algorithm>

namespace {

QFrame* Rule(QWidget* parent) {
    auto* line = new QFrame(parent);
    line->setFrameShape(QFrame::HLine);
    line->setFrameShadow(QFrame::Sunken);
    return line;
}

} // namespace

Wg_Wizard::Wg_Wizard(QWidget* parent) : QDialog(parent) {
    setObjectName("Wg_Wizard");
    setSizeGripEnabled(true);

    auto* layout = new QVBoxLayout(this);

    auto* body = new QHBoxLayout;
    // The list of steps tells the user where they are and which pages the
    // current settings leave out.
    m_steps = new QListWidget(this);
    m_steps->setObjectName("pageList");
    m_steps->setSelectionMode(QAbstractItemView::NoSelection);
    m_steps->setFocusPolicy(Qt::NoFocus);
    m_steps->setFrameShape(QFrame::StyledPanel);
    m_steps->setFixedWidth(230);
    m_steps->setWordWrap(true);
    m_steps->setSpacing(3);
    body->addWidget(m_steps);

    auto* right = new QVBoxLayout;
    m_title = new QLabel(this);
    m_title->setObjectName("pageTitle");
    QFont titleFont = m_title->font();
    titleFont.setBold(true);
    titleFont.setPointSizeF(titleFont.pointSizeF() * 1.3);
    m_title->setFont(titleFont);
    right->addWidget(m_title);
    right->addWidget(Rule(this));
    m_stack = new QStackedWidget(this);
    m_stack->setObjectName("pageStack");
    m_emptyPage = new QWidget(m_stack);
    m_stack->addWidget(m_emptyPage);
    right->addWidget(m_stack, 1);
    body->addLayout(right, 1);
    layout->addLayout(body, 1);
    layout->addWidget(Rule(this));

    auto* buttons = new QHBoxLayout;
    m_moreInfo = new QPushButton(tr("More Info"), this);
    m_moreInfo->setObjectName("buttonMoreInfo");
    m_moreInfo->setEnabled(false);
    m_back = new QPushButton(tr("Back"), this);
    m_back->setObjectName("buttonBack");
    m_back->setIcon(style()->standardIcon(QStyle::SP_ArrowBack));
    m_next = new QPushButton(tr("Next"), this);
    m_next->setObjectName("buttonNext");
    m_next->setIcon(style()->standardIcon(QStyle::SP_ArrowForward));
    m_next->setLayoutDirection(Qt::RightToLeft); // arrow after the text
    m_finish = new QPushButton(tr("Finish"), this);
    m_finish->setObjectName("buttonFinish");
    m_cancel = new QPushButton(tr("Cancel"), this);
    m_cancel->setObjectName("buttonCancel");
    // Enter in a form moves on, as in any wizard; the other buttons must not
    // steal the default when they get the focus.
    for (QPushButton* b : {m_moreInfo, m_back, m_finish, m_cancel})
        b->setAutoDefault(false);
    m_next->setDefault(true);
    buttons->addWidget(m_moreInfo);
    buttons->addStretch(1);
    buttons->addWidget(m_back);
    buttons->addWidget(m_next);
    buttons->addSpacing(12);
    buttons->addWidget(m_finish);
    buttons->addWidget(m_cancel);
    layout->addLayout(buttons);

    connect(m_moreInfo, &QPushButton::clicked, this, &Wg_Wizard::moreInfo);
    connect(m_back, &QPushButton::clicked, this, &Wg_Wizard::back);
    connect(m_next, &QPushButton::clicked, this, &Wg_Wizard::next);
    connect(m_finish, &QPushButton::clicked, this, &Wg_Wizard::finish);
    connect(m_cancel, &QPushButton::clicked, this, &Wg_Wizard::reject);

    resize(860, 600);
    updateChrome();
}

Wg_Wizard::~Wg_Wizard() = default;

bool Wg_Wizard::addPage(Wg_WizardPage* page) {
    if (!page || indexOf(page) >= 0)
        return false;
    const int summaryAt = m_summary ? indexOf(m_summary) : -1;
    const Entry entry{page, true, false};
    int at = pageCount();
    if (summaryAt >= 0 && page != m_summary) {
        at = summaryAt;
        m_pages.insert(at, entry);
        if (m_current >= at)
            ++m_current;
    } else {
        m_pages.append(entry);
    }
    if (QWidget* w = page->pageWidget())
        holderFor(w);
    updateChrome();
    return true;
}

QWidget* Wg_Wizard::shownForm() const {
    QWidget* w = m_stack->currentWidget();
    auto* area = qobject_cast<QScrollArea*>(w);
    return area ? area->widget() : w;
}

QWidget* Wg_Wizard::holderFor(QWidget* form) {
    // Each form scrolls on its own, so that the tallest page does not set the
    // height of the dialog (or of every other page) on a small screen.
    for (int i = 0; i < m_stack->count(); ++i)
        if (auto* area = qobject_cast<QScrollArea*>(m_stack->widget(i)))
            if (area->widget() == form)
                return area;
    auto* area = new QScrollArea(m_stack);
    area->setObjectName("pageScrollArea");
    area->setFrameShape(QFrame::NoFrame);
    area->setWidgetResizable(true);
    area->setWidget(form);
    m_stack->addWidget(area);
    return area;
}

void Wg_Wizard::enablePage(const QString& pageName, bool enable) {
    for (auto& e : m_pages)
        if (e.page && e.page->pageName() == pageName)
            e.enabled = enable;
    updateChrome();
}

bool Wg_Wizard::isPageEnabled(const QString& pageName) const {
    for (const auto& e : m_pages)
        if (e.page && e.page->pageName() == pageName)
            return e.enabled;
    return false;
}

void Wg_Wizard::enableMoreInfo(bool enable) {
    m_moreInfo->setEnabled(enable);
}

Wg_WizardPage* Wg_Wizard::page(int i) const {
    return i >= 0 && i < m_pages.size() ? m_pages[i].page.data() : nullptr;
}

Wg_WizardPage* Wg_Wizard::findPage(const QString& pageName) const {
    for (const auto& e : m_pages)
        if (e.page && e.page->pageName() == pageName)
            return e.page;
    return nullptr;
}

int Wg_Wizard::indexOf(const Wg_WizardPage* page) const {
    if (!page)
        return -1;
    for (int i = 0; i < m_pages.size(); ++i)
        if (m_pages[i].page == page)
            return i;
    return -1;
}

void Wg_Wizard::setSummaryPage(Wg_WizardPage* page) {
    m_summary = page;
    // Keep it last even when it was added before other pages.
    const int at = indexOf(page);
    if (at >= 0 && at != pageCount() - 1) {
        const Entry e = m_pages.takeAt(at);
        m_pages.append(e);
        if (m_current == at)
            m_current = pageCount() - 1;
        else if (m_current > at)
            --m_current;
    }
    updateChrome();
}

bool Wg_Wizard::isSummary(int index) const {
    return m_summary && index >= 0 && index < m_pages.size() && m_pages[index].page == m_summary;
}

int Wg_Wizard::nextEnabled(int from) const {
    for (int i = from + 1; i < m_pages.size(); ++i)
        if (m_pages[i].page && (m_pages[i].enabled || isSummary(i)))
            return i;
    return -1;
}

int Wg_Wizard::prevEnabled(int from) const {
    for (int i = std::min(from, static_cast<int>(m_pages.size())) - 1; i >= 0; --i)
        if (m_pages[i].page && (m_pages[i].enabled || isSummary(i)))
            return i;
    return -1;
}

void Wg_Wizard::setVisible(bool visible) {
    // Before the window appears, so that it is laid out for the first page.
    if (visible && m_current < 0 && !m_busy) {
        const int first = nextEnabled(-1);
        if (first >= 0) {
            m_busy = true;
            if (isSummary(first))
                enterSummary(first);
            else
                showPage(first);
            m_busy = false;
        }
    }
    QDialog::setVisible(visible);
}

void Wg_Wizard::showPage(int index) {
    Entry& e = m_pages[index];
    Wg_WizardPage* p = e.page;
    m_current = index;
    // Each page enables More Info for itself when it has help.
    m_moreInfo->setEnabled(false);
    if (!e.initialized) {
        e.initialized = true;
        p->init();
    }
    p->onActive();
    QWidget* w = p->pageWidget();
    m_stack->setCurrentWidget(w ? holderFor(w) : m_emptyPage);
    updateChrome();
    emit pageShown(index);
}

bool Wg_Wizard::enterSummary(int index) {
    const bool ok = m_enterSummary ? m_enterSummary() : true;
    showPage(index);
    return ok;
}

void Wg_Wizard::next() {
    Wg_WizardPage* p = currentPage();
    if (m_busy || !p)
        return;
    m_busy = true;
    if (p->onNext()) {
        // The page may have enabled or disabled others while writing.
        const int target = nextEnabled(m_current);
        if (target >= 0) {
            if (isSummary(target))
                enterSummary(target);
            else
                showPage(target);
        }
    }
    m_busy = false;
}

void Wg_Wizard::back() {
    Wg_WizardPage* p = currentPage();
    if (m_busy || !p)
        return;
    m_busy = true;
    if (p->onBack()) {
        const int target = prevEnabled(m_current);
        if (target >= 0) {
            if (isSummary(m_current) && m_leaveSummary)
                m_leaveSummary();
            showPage(target);
        }
    }
    m_busy = false;
}

void Wg_Wizard::finish() {
    Wg_WizardPage* p = currentPage();
    if (m_busy)
        return;
    m_busy = true;
    bool done = true;
    if (p && p->onFinish()) {
        done = false; // the page keeps the dialog
    } else if (p && !isSummary(m_current)) {
        // Finishing early goes through the summary as Next would, without
        // writing the pages in between.
        const int summaryAt = indexOf(m_summary);
        if (summaryAt >= 0)
            done = enterSummary(summaryAt);
    }
    m_busy = false;
    if (done)
        accept();
}

void Wg_Wizard::moreInfo() {
    if (Wg_WizardPage* p = currentPage())
        p->onMoreInfo();
}

void Wg_Wizard::reject() {
    if (m_busy)
        return;
    if (Wg_WizardPage* p = currentPage()) {
        m_busy = true;
        const bool leave = p->onCancel();
        m_busy = false;
        if (!leave)
            return;
    }
    QDialog::reject();
}

QString Wg_Wizard::buttonLabel(const QString& name, int target, const QString& fallback) const {
    const Wg_WizardPage* to = page(target);
    if (name.isEmpty())
        return to && !to->pageName().isEmpty() ? to->pageName() : fallback;
    // A name that points at a skipped page would send the user somewhere
    // else than the button says.
    if (to && findPage(name) && !isPageEnabled(name) && findPage(name) != m_summary)
        return to->pageName().isEmpty() ? fallback : to->pageName();
    return name;
}

void Wg_Wizard::updateChrome() {
    const Wg_WizardPage* p = currentPage();
    const int before = prevEnabled(m_current);
    const int after = nextEnabled(m_current);
    m_back->setEnabled(p && before >= 0);
    m_next->setEnabled(p && after >= 0);
    m_finish->setEnabled(p != nullptr);
    m_back->setText(p ? buttonLabel(p->pageBackName(), before, tr("Back")) : tr("Back"));
    m_next->setText(p ? buttonLabel(p->pageNextName(), after, tr("Next")) : tr("Next"));
    m_title->setText(p ? p->pageName() : QString());

    m_steps->clear();
    for (int i = 0; i < m_pages.size(); ++i) {
        const Entry& e = m_pages[i];
        if (!e.page)
            continue;
        auto* item = new QListWidgetItem(e.page->pageName(), m_steps);
        const bool on = e.enabled || isSummary(i);
        QFont f = m_steps->font();
        if (i == m_current) {
            f.setBold(true);
            item->setText(QString::fromUtf8("\u25B8 ") + e.page->pageName());
        } else {
            item->setText(QString::fromUtf8("   ") + e.page->pageName());
        }
        item->setFont(f);
        item->setFlags(on ? Qt::ItemIsEnabled : Qt::NoItemFlags);
        if (!on)
            item->setToolTip(tr("Not used with the current settings"));
    }
}
