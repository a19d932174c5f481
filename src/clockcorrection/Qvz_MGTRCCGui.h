#pragma once
// GUI controller of the "Receiver Clock Correction Setup" page.

#include "Qvz_MGTPageGui.h"
#include "Qvz_MGTRCC.h"

class Qvz_MGTRCCWidget;

class Qvz_MGTRCCGui : public Qvz_MGTPageGui, public Qvz_MGTRCCView {
    Q_OBJECT
public:
    // Validated entries, in checking order.
    enum EntryIndex {
        kSeq1Mask = 0,
        kSeq2Mask,
        kSeq1First,                  // the four elements of the first sequence
        kSeq2First = kSeq1First + 4, // the four of the second
        kEntryCount = kSeq2First + 4
    };

    Qvz_MGTRCCGui(Qvz_MGTRCC* page, QWidget* parent);
    ~Qvz_MGTRCCGui() override;

    Qvz_MGTRCCWidget* Form() const { return m_pForm; }

    // What the page asks of its form while it reads the block.
    void InitDataMembers(Qvz_Block* block) override;
    void UpdateData(bool save) override { Qvz_MGTPageGui::UpdateData(save); }
    void UpdateControls() override;
    QComboBox* SeqLengthComboBox() override;
    QSpinBox* LatencySpinBox(SpinBoxId which) override;

    void DataToWidgets() override;
    void WidgetsToData() override;
    // The chosen sequence length: the page's in a batch run, else the form's.
    Port::StringBase GetSeqLength() const;

public slots:
    void onActive() override { Qvz_MGTPageGui::onActive(); }
    bool onCancel() override { return Qvz_MGTPageGui::onCancel(); }
    bool onBack() override { return Qvz_MGTPageGui::onBack(); }
    bool onNext() override { return Qvz_MGTPageGui::onNext(); }
    bool onFinish() override { return Qvz_MGTPageGui::onFinish(); }
    void onMoreInfo() override { Qvz_MGTPageGui::onMoreInfo(); }
    void init() override { Qvz_MGTPageGui::init(); }
    void OnCheckClkCorSeq2Use();
    void OnComboSeqLen();
    // Keep the latency window open by one; nothing connects them.
    void OnMaxChanged(int value);
    void OnMinChanged(int value);
    // The validators refuse bad characters while the user types; nothing is
    // left to do here.
    void ValidateLE_ALL() {}

protected:
    bool ReadPage() override;
    bool WritePage() override;

private:
    // Line edit of sequence element 0..7 (1_1 .. 2_4).
    QLineEdit* SeqEdit(int element) const { return m_entries[kSeq1First + element].m_pLineEdit; }

    Qvz_MGTRCCWidget* m_pForm = nullptr;
    Qvz_MGTRCC* m_pPage = nullptr;
};
