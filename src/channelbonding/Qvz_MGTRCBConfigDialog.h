#pragma once
// Read-only view of where the bonded GT or GT10 transceivers go: one check box
// per location of the top and bottom edge, ticked where the bonding number
// uses it, labelled with the role the transceiver there gets.

#include "Port_StringBase.h"
#include "Qvz_MGTRCBConfigDialogBase.h"

class QCheckBox;
class QLabel;

class Qvz_MGTRCBConfigDialog : public Qvz_MGTRCBConfigDialogBase {
    Q_OBJECT
public:
    static constexpr int kColumns = 12;
    static constexpr int kLocations = 2 * kColumns;

    explicit Qvz_MGTRCBConfigDialog(QWidget* parent = nullptr, const char* name = nullptr,
                                    bool modal = false, Qt::WindowFlags fl = {});
    ~Qvz_MGTRCBConfigDialog() override;

    // Loads the grid from m_cbondNum, m_maxCBondNum and m_primaryRowBottom.
    void DataToWidgets();

    // "M", "S1" or "S2" for the role of position i when the bonding number
    // uses it, else nothing.
    static QString RoleLabelText(const Port::StringBase& mode, int i, int cbondNum);

    // Location (column, row) of the grid; row 1 is the top edge. Null outside.
    QCheckBox* CheckBox(int column, int row) const;
    QLabel* RoleLabel(int column, int row) const;

    // The bottom row's twelve, then the top row's, by column.
    bool m_states[kLocations] = {};
    int m_cbondNum = 4;
    int m_maxCBondNum = 24;
    // 0: the master's row is the top edge.
    int m_primaryRowBottom = 0;

private:
    QCheckBox* m_checks[kLocations] = {};
    QLabel* m_labels[kLocations] = {};
};
