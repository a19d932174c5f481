#pragma once
// Where each bonded transceiver sits on the chip and which bonding role it
// has. Shared by the channel bonding page (master LOC, copies) and the
// placement dialogs, so that what is shown is what is generated.
//
// Positions: 0 is the master, 2..N the slaves (1 is never used: its column is
// the master's). With M the family maximum, a row holds h = M / 2 positions and
// the master sits in column h / 2 of the primary row.

#include "Port_StringBase.h"
#include "Qvz_WizData.h"

class Qvz_MGTRCBPlacement {
public:
    // maxBond below 0 counts as 0; primaryRowBottom non-zero puts the master
    // in row 0 (Bottom, or Left on GT11).
    Qvz_MGTRCBPlacement(Qvz_Family family, int maxBond, int primaryRowBottom);

    int MaxBond() const { return m_max; }
    int RowLength() const { return m_max / 2; }
    int MasterColumn() const { return m_max / 2 / 2; }

    // Column along the edge and row (0 or 1) of position i.
    int Column(int i) const;
    int Row(int i) const;
    // GT and GT10: X is the column, Y the row; GT11 has them the other way.
    int LocX(int i) const;
    int LocY(int i) const;
    // "MASTER", "SLAVE_1_HOP" or "SLAVE_2_HOPS".
    Port::StringBase BondMode(int i) const;
    // Position whose CHBONDO drives the CHBONDI of the two-hop slave i.
    int Feeder(int i) const;
    // "GT_X5Y1", "GT10_X..." or "GT11_X...".
    Port::StringBase LocString(int x, int y) const;

private:
    Qvz_Family m_family;
    int m_max;
    bool m_bottom;
};
