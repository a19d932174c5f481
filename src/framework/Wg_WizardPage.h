#pragma once
// A page of the wizard dialog: a name, the labels of its Back and Next
// buttons, the form it shows, and the hooks the dialog calls.

#include <QObject>
#include <QPointer>
#include <QString>
#include <QWidget>

class Wg_WizardPage : public QObject {
    Q_OBJECT
public:
    explicit Wg_WizardPage(QWidget* parent);
    ~Wg_WizardPage() override;

    void setPageName(const QString& name) { m_pageName = name; }
    QString pageName() const { return m_pageName; }
    void setPageBackName(const QString& name) { m_backName = name; }
    QString pageBackName() const { return m_backName; }
    void setPageNextName(const QString& name) { m_nextName = name; }
    QString pageNextName() const { return m_nextName; }
    // The page takes the form; the dialog shows it while the page is current.
    void setPageWidget(QWidget* widget);
    QWidget* pageWidget() const { return m_widget; }
    QWidget* parentWidget() const { return m_parent; }

    virtual bool isAdvanced() { return false; }
    virtual void dataToWidgets() {}
    virtual void widgetsToData() {}

public slots:
    virtual void onActive() {}
    virtual bool onCancel() { return true; }
    virtual bool onBack() { return true; }
    virtual bool onNext() { return true; }
    // True keeps the dialog on this page.
    virtual bool onFinish() { return false; }
    virtual void onMoreInfo() {}
    virtual void onAdvanced() {}
    virtual void init() {}

private:
    QString m_pageName;
    QString m_backName;
    QString m_nextName;
    QPointer<QWidget> m_widget;
    QPointer<QWidget> m_parent;
};
