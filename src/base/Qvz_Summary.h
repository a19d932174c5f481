#pragma once
// What the design data holds for the host after a run, in a form both the
// summary page and the command line can show.

#include "Qvz_WizData.h"

#include <QString>
#include <vector>

struct Qvz_Summary {
    struct Port {
        QString pin;
        QString signal;
        QString direction; // "in", "out" or "inout"
        int width = 1;
    };
    struct Tie {
        QString pin;
        int level = 0;
    };
    struct Copy {
        QString name;
        QString loc;
        QString role;
    };
    bool hasBlock = false;
    QString instance;
    QString primitive;
    QString type;
    QString dataWidth;
    QString loc;  // placement of the active block, "" when unplaced
    QString role; // its CHAN_BOND_MODE, "" when it has none
    std::vector<Port> ports;
    std::vector<Tie> ties;
    std::vector<QString> bitMapped; // pins wired bit by bit
    std::vector<Port> wired;        // pins on internal signals
    std::vector<QString> unconnected;
    std::vector<QString> internals; // internal signals in use
    std::vector<Copy> copies;       // bonded copies of the block

    static Qvz_Summary Of(const Qvz_WizData& data);
    // Multi-line text; brief leaves out the per-pin lists (ports, ties,
    // internal pins and signals, unconnected pins).
    QString ToText(bool brief) const;
    // The same, fully, as HTML for the summary page. finished false says the
    // finish routine has not completed, so ports and copies may be missing.
    QString ToHtml(bool finished) const;
};
