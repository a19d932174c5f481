#pragma once
// GUI controller of the "Receiver Setup" page. Besides moving the page's
// fields in and out of the form it keeps the decoding choice and the two
// synchronization groups consistent: the loss-of-sync counters only mean
// something with 8B/10B decoding, the sync-header counters only with 64B/66B.

#include "Qvz_MGTPageGui.h"

class Qvz_Block;
class Qvz_MGTRX;
class Qvz_MGTRXWidget;

class Qvz_MGTRXGui : public Qvz_MGTPageGui {
    Q_OBJECT
public:
    // Validated entries, in checking order.
    enum EntryIndex { kAfeEq = 0, kCrcInit, kEntryCount };

    Qvz_MGTRXGui(Qvz_MGTRX* page, QWidget* parent);
    ~Qvz_MGTRXGui() override;

    Qvz_MGTRXWidget* Form() const { return m_pForm; }

    void LoadComboBoxes(Qvz_Block* block) override;
    void DataToWidgets() override;
    void WidgetsToData() override;
    void UpdateCrcControls();
    // A null block means the page's active block.
    void UpdateLossOfSyncControls(Qvz_Block* block);
    void Update64bControls(Qvz_Block* block);
    void UpdateDecodingControls(Qvz_Block* block);

public slots:
    void onActive() override { Qvz_MGTPageGui::onActive(); }
    bool onCancel() override { return Qvz_MGTPageGui::onCancel(); }
    bool onBack() override { return Qvz_MGTPageGui::onBack(); }
    bool onNext() override { return Qvz_MGTPageGui::onNext(); }
    bool onFinish() override { return Qvz_MGTPageGui::onFinish(); }
    void onMoreInfo() override { Qvz_MGTPageGui::onMoreInfo(); }
    void init() override { Qvz_MGTPageGui::init(); }
    void OnCheckRxLossOfSync();
    void OnCheckUseCRC();
    void OnRadioDecoding();
    void OnRadio8b10bDecoding();
    // The validators refuse bad characters while the user types; this has
    // nothing left to do.
    void ValidateLE_ALL() {}

protected:
    bool ReadPage() override;
    bool WritePage() override;
    void UpdateControls() override;

private:
    Qvz_Block* BlockOrActive(Qvz_Block* block) const { return block ? block : ActiveBlock(); }

    Qvz_MGTRXWidget* m_pForm = nullptr;
    Qvz_MGTRX* m_pPage = nullptr;
};
