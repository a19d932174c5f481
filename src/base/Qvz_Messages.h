#pragma once
// Where the messages a wizard issues go. Every message is also recorded on
// the wizard main for the run report; the sink decides how the user sees it.

#include "Port_StringBase.h"

#include <vector>

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
