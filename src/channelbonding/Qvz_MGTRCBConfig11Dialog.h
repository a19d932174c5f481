#pragma once
// Read-only view of where the bonded GT11 transceivers go: one check box per
// location of the left and right edge, ticked where the bonding number uses
// it, labelled with the role the transceiver there gets.

#include "Qvz_MGTRCBConfig11DialogBase.h"

class QCheckBox;
class QLabel;
class Qvz_MGTRCB;

class Qvz_MGTRCBConfig11Dialog : public Qvz_MGTRCBConfig11DialogBase {
    Q_OBJECT
public:
    static constexpr int kRows = 18;
    static constexpr int kLocations = 2 * kRows;

    explicit Qvz_MGTRCBConfig11Dialog(QWidget* parent = nullptr, const char* name = nullptr,
                                      bool modal = false, Qt::WindowFlags fl = {});
    ~Qvz_MGTRCBConfig11Dialog() override;

    // Loads the grid from the page's placement, m_cbondNum and m_maxCBondNum.
    void DataToWidgets();

    // Location (x, y): x 0 is the left edge, y 0 the bottom row. Null outside.
    QCheckBox* CheckBox(int x, int y) const;
    QLabel* RoleLabel(int x, int y) const;

    int m_cbondNum = 4;
    int m_maxCBondNum = 24;
    // The left column's eighteen, then the right column's, by row.
    bool m_states[kLocations] = {};
    Qvz_MGTRCB* m_pPage = nullptr;

private:
    QCheckBox* m_checks[kLocations] = {};
    QLabel* m_labels[kLocations] = {};
};
