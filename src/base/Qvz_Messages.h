#pragma once
// Where the messages a wizard issues go. Every message is also recorded on
// the wizard main for the run report; the sink decides how the user sees it.

#include "Port_StringBase.h"

#include <QPointer>
#include <vector>

class QDialog;
class QTextBrowser;
class Qvz_WizMain;

struct Qvz_Message {
    Port::StringBase text;
    bool flag1 = false; // set: an error (critical box, "error: " prefix)
    bool flag2 = false;
    bool flag3 = false;
};

class Qvz_MessageSink {
public:
    virtual ~Qvz_MessageSink() = default;
    virtual void Show(const Qvz_Message& message) = 0;
};

// Writes each message to standard error, prefixed "error: " or "note: ".
class Qvz_StderrSink : public Qvz_MessageSink {
public:
    void Show(const Qvz_Message& message) override;
};

// Window runs: a message box parented to the wizard dialog, critical when
// the first flag is set. Falls back to standard error where no GUI exists.
class Qvz_MessageBoxSink : public Qvz_MessageSink {
public:
    explicit Qvz_MessageBoxSink(const Qvz_WizMain* main) : m_pMain(main) {}
    void Show(const Qvz_Message& message) override;

private:
    const Qvz_WizMain* m_pMain;
};

// Keeps the messages it is shown (tests).
class Qvz_RecordingSink : public Qvz_MessageSink {
public:
    void Show(const Qvz_Message& message) override { messages.push_back(message); }
    std::vector<Qvz_Message> messages;
};

// Opens help by key; the default window run shows the shipped help pages.
class Qvz_HelpHandler {
public:
    virtual ~Qvz_HelpHandler() = default;
    virtual void Open(const Port::StringBase& key) = 0;
};

// Window runs: shows the help page of a key (":/help/<key>.html", shipped
// with the library) in a window beside the wizard dialog. The window stays
// open while the user goes on working.
class Qvz_HelpWindow : public Qvz_HelpHandler {
public:
    explicit Qvz_HelpWindow(const Qvz_WizMain* main) : m_pMain(main) {}
    ~Qvz_HelpWindow() override;
    void Open(const Port::StringBase& key) override;

    // The resource of a key's page, or "" when the library has none.
    static QString PageOf(const Port::StringBase& key);
    QDialog* Window() const;

private:
    const Qvz_WizMain* m_pMain;
    QPointer<QDialog> m_window;
    QTextBrowser* m_browser = nullptr;
};
