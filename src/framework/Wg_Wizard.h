#pragma once
// The wizard dialog: one page at a time with Back, Next, Finish, Cancel and
// More Info.
//
// The dialog knows nothing of the design data. A caller that needs work done
// when the summary page is entered or left backwards installs hooks for it.

#include "Wg_WizardPage.h"

#include <QDialog>
#include <QList>
#include <QPointer>

#include <functional>

class QLabel;
class QListWidget;
class QPushButton;
class QStackedWidget;

class Wg_Wizard : public QDialog {
    Q_OBJECT
public:
    // Runs when the summary page is entered; false means the summary could
    // not be completed (Finish from a setup page then stays on the summary).
    using EnterSummaryHook = std::function<bool()>;
    // Runs when the summary page is left by Back.
    using LeaveSummaryHook = std::function<void()>;

    explicit Wg_Wizard(QWidget* parent = nullptr);
    ~Wg_Wizard() override;

    // Appends a page (before the summary page, which stays last). False for
    // a null page or one that was added already.
    bool addPage(Wg_WizardPage* page);
    void setCaption(const QString& text) { setWindowTitle(text); }
    // Enables or disables the page of that name (disabled pages are skipped).
    void enablePage(const QString& pageName, bool enable);
    bool isPageEnabled(const QString& pageName) const;
    void enableMoreInfo(bool enable);

    int pageCount() const { return static_cast<int>(m_pages.size()); }
    Wg_WizardPage* page(int i) const;
    Wg_WizardPage* findPage(const QString& pageName) const;
    int indexOf(const Wg_WizardPage* page) const;

    // Marks the summary page: it is kept last, entering it runs the enter
    // hook and leaving it by Back runs the leave hook. It is added by
    // addPage like any other page.
    void setSummaryPage(Wg_WizardPage* page);
    Wg_WizardPage* summaryPage() const { return m_summary; }
    void setEnterSummaryHook(EnterSummaryHook hook) { m_enterSummary = std::move(hook); }
    void setLeaveSummaryHook(LeaveSummaryHook hook) { m_leaveSummary = std::move(hook); }

    // The page shown, or null before the dialog has been shown.
    Wg_WizardPage* currentPage() const { return page(m_current); }
    int currentIndex() const { return m_current; }

    // Showing the dialog the first time shows its first enabled page.
    void setVisible(bool visible) override;

public slots:
    // The four buttons; each asks the current page first.
    void next();
    void back();
    void finish();
    void moreInfo();
    // Cancel, Escape and closing the window: ends the run when the current
    // page lets it.
    void reject() override;

signals:
    // A page has just been shown.
    void pageShown(int index);

private:
    struct Entry {
        QPointer<Wg_WizardPage> page; // pages are QObjects others may delete
        bool enabled;
        bool initialized;
    };
    int nextEnabled(int from) const;
    int prevEnabled(int from) const;
    bool isSummary(int index) const;
    void showPage(int index);
    // Shows the summary page after running the enter hook; returns the hook's answer.
    bool enterSummary(int index);
    void updateChrome();
    QString buttonLabel(const QString& name, int target, const QString& fallback) const;

    QList<Entry> m_pages;
    int m_current = -1;
    bool m_busy = false;
    Wg_WizardPage* m_summary = nullptr;
    EnterSummaryHook m_enterSummary;
    LeaveSummaryHook m_leaveSummary;

    QLabel* m_title = nullptr;
    QListWidget* m_steps = nullptr;
public:
    // The form shown now (a page's widget, or an empty placeholder).
    QWidget* shownForm() const;

private:
    // The scroll area that holds a page's form in the stack (made on first use).
    QWidget* holderFor(QWidget* form);

    QStackedWidget* m_stack = nullptr;
    QWidget* m_emptyPage = nullptr;
    QPushButton* m_moreInfo = nullptr;
    QPushButton* m_back = nullptr;
    QPushButton* m_next = nullptr;
    QPushButton* m_finish = nullptr;
    QPushButton* m_cancel = nullptr;
};
