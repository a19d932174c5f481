#pragma once
// GUI controller of the "Receiver Channel Bonding Setup" page.

#include "Qvz_MGTPageGui.h"
#include "Qvz_MGTRCB.h"

class Qvz_MGTRCBWidget;

class Qvz_MGTRCBGui : public Qvz_MGTPageGui, public Qvz_MGTRCBView {
    Q_OBJECT
public:
    // Validated entries, in checking order: the eight sequence characters
    // (1_1 .. 2_4), then the two masks.
    enum EntryIndex { kSeqFirst = 0, kSeq1Mask = kSeqFirst + 8, kSeq2Mask, kEntryCount };

    Qvz_MGTRCBGui(Qvz_MGTRCB* page, QWidget* parent);
    ~Qvz_MGTRCBGui() override;

    Qvz_MGTRCBWidget* Form() const { return m_pForm; }

    // What the page asks of its form while it reads the block.
    QComboBox* SeqLenComboBox() override;
    QSpinBox* CBondNumSpinBox() override;
    QSpinBox* LimitSpinBox() override;
    QSpinBox* OffsetSpinBox() override;
    QSpinBox* WaitSpinBox() override;

    void DataToWidgets() override;
    void WidgetsToData() override;

    // Finishing from this page enters the summary as Next would, so it
    // checks and writes as Next does; true (stay) when that fails.
    bool onFinish() override;

public slots:
    void onActive() override { Qvz_MGTPageGui::onActive(); }
    bool onCancel() override { return Qvz_MGTPageGui::onCancel(); }
    // Writes the settings without the entry checks and without the master's
    // role and placement.
    bool onBack() override;
    // Checks the enabled entries, then writes everything.
    bool onNext() override { return Qvz_MGTPageGui::onNext(); }
    void onMoreInfo() override { Qvz_MGTPageGui::onMoreInfo(); }
    void init() override { Qvz_MGTPageGui::init(); }
    void OnButtonViewPlacement();
    void OnButtonDefineLaneID();
    // Keeps the number on legal values: 1 is skipped, GT11 moves in pairs,
    // and the ends wrap.
    void OnSpinCBondNum(int value);
    void OnCheckCBondSeq2Use();
    // The validators refuse bad characters while the user types; nothing is
    // left to do here.
    void ValidateLE_ALL() {}

protected:
    bool ReadPage() override;
    // The full write (Next).
    bool WritePage() override;
    void UpdateControls() override;

private:
    // The number in m_cbondNumText when the page may bond that many, else
    // -1 after the range message.
    int CheckedBondNumber();
    QLineEdit* SeqEdit(int s) const { return m_entries[kSeqFirst + s].m_pLineEdit; }

    Qvz_MGTRCBWidget* m_pForm = nullptr;
    Qvz_MGTRCB* m_pPage = nullptr;
};
