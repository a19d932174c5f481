#pragma once
// The wizard dialog: one page at a time with Back, Next, Finish, Cancel and
// More Info.

#include "Wg_WizardPage.h"

#include <QDialog>
#include <QList>

class QLabel;
class QPushButton;
class QStackedWidget;

class Wg_Wizard : public QDialog {
    Q_OBJECT
public:
    explicit Wg_Wizard(QWidget* parent = nullptr);
    ~Wg_Wizard() override;

    bool addPage(Wg_WizardPage* page);
    void setCaption(const QString& text) { setWindowTitle(text); }
    // Enables or disables the page of that name (disabled pages are skipped).
    void enablePage(const QString& pageName, bool enable);
    bool isPageEnabled(const QString& pageName) const;
    void enableMoreInfo(bool enable);

    int pageCount() const { return static_cast<int>(m_pages.size()); }
    Wg_WizardPage* page(int i) const;
    Wg_WizardPage* findPage(const QString& pageName) const;

private:
    struct Entry {
        Wg_WizardPage* page;
        bool enabled;
    };
    QList<Entry> m_pages;
    QStackedWidget* m_stack = nullptr;
    QPushButton* m_moreInfo = nullptr;
};
