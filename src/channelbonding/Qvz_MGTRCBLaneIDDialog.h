#pragma once
// One LANE_ID entry per bonded transceiver (up to 24), each checked for eleven
// binary digits; the edited list goes back to the caller only on OK.

#include "Port_StringBase.h"
#include "Qvz_MGTPageGui.h"
#include "Qvz_MGTRCBLaneIDDialogBase.h"
#include "Qvz_StrArray.h"

class Qvz_MGTRCBLaneIDDialog : public Qvz_MGTRCBLaneIDDialogBase {
    Q_OBJECT
public:
    static constexpr int kEntries = 24;

    explicit Qvz_MGTRCBLaneIDDialog(QWidget* parent = nullptr, const char* name = nullptr,
                                    bool modal = false, Qt::WindowFlags fl = {});
    ~Qvz_MGTRCBLaneIDDialog() override;

    // Takes every entry of list, at the same index.
    void SetLaneIds(const Qvz_StrArray& list);
    // m_laneIds -> entries 1..m_cbondNum, then all entries -> line edits.
    void DataToWidgets();
    // Line edits -> m_laneText.
    void WidgetsToData();

    // Line edit of entry k, 1..24; null outside.
    QLineEdit* Entry(int k) const;
    QLabel* EntryLabel(int k) const;

public slots:
    // Refuses an entry that is not eleven binary digits; else hands the
    // entries in use back through m_laneIds and accepts.
    void OnOK();
    // The validators refuse bad characters while the user types.
    void ValidateLE_ALL() {}

public:
    Qvz_MGTPageGui::LEValidator m_entries[kEntries];
    // Entry k - 1 belongs to transceiver k.
    Qvz_StrArray m_laneIds;
    int m_cbondNum = 4;
    // Working copy of entries 1..24 (index 0 unused).
    Port::StringBase m_laneText[kEntries + 1];

private:
    QLabel* m_labels[kEntries] = {};
};
