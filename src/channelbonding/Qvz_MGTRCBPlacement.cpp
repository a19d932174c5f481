#include "Qvz_MGTRCBPlacement.h"

Qvz_MGTRCBPlacement::Qvz_MGTRCBPlacement(Qvz_Family family, int maxBond, int primaryRowBottom)
    : m_family(family), m_max(maxBond < 0 ? 0 : maxBond), m_bottom(primaryRowBottom != 0) {}

namespace {
// Fills a row alternately left and right of its middle, starting at the
// middle for k = 1.
int AlternatingColumn(int h, int k) {
    if (k % 2 == 0) {
        // With an odd maximum the opposite row has one position more than
        // the primary row; its last one takes the extra column at the end
        // instead of falling onto column 0 a second time.
        if (k > h)
            return h;
        return (h - k) / 2;
    }
    return (h + k - 1) / 2;
}
} // namespace

int Qvz_MGTRCBPlacement::Column(int i) const {
    const int h = RowLength();
    if (i <= 0)
        return MasterColumn();
    if (i <= h)
        return AlternatingColumn(h, i);
    return AlternatingColumn(h, i - h);
}

int Qvz_MGTRCBPlacement::Row(int i) const {
    const bool primary = i <= RowLength();
    return primary == m_bottom ? 0 : 1;
}

int Qvz_MGTRCBPlacement::LocX(int i) const {
    return m_family == Qvz_Family::GT11 ? Row(i) : Column(i);
}

int Qvz_MGTRCBPlacement::LocY(int i) const {
    return m_family == Qvz_Family::GT11 ? Column(i) : Row(i);
}

Port::StringBase Qvz_MGTRCBPlacement::BondMode(int i) const {
    const int h = RowLength();
    if (i <= 0)
        return "MASTER";
    if (i <= h) {
        const int t = MasterColumn() - Column(i) + 2;
        return t >= 0 && t <= 4 ? "SLAVE_1_HOP" : "SLAVE_2_HOPS";
    }
    return i == h + 1 ? "SLAVE_1_HOP" : "SLAVE_2_HOPS";
}

int Qvz_MGTRCBPlacement::Feeder(int i) const {
    const int h = RowLength();
    if (i > h)
        return h + 1;
    const int p = Column(i);
    const int mid = MasterColumn();
    if (i % 2 == 0)
        return mid - p < 5 ? i - 4 : 4;
    return p - mid < 5 ? i - 4 : 5;
}

Port::StringBase Qvz_MGTRCBPlacement::LocString(int x, int y) const {
    const char* prefix = m_family == Qvz_Family::GT11   ? "GT11_X"
                         : m_family == Qvz_Family::GT10 ? "GT10_X"
                                                        : "GT_X";
    Port::StringBase s;
    s.Format("%s%dY%d", prefix, x, y);
    return s;
}
