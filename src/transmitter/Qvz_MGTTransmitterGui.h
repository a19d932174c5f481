#pragma once
// GUI controller of the "Transmitter Setup" page.

#include "Qvz_MGTPageGui.h"

class Qvz_Block;
class Qvz_MGTTXWidget;
class Qvz_MGTTransmitter;

class Qvz_MGTTransmitterGui : public Qvz_MGTPageGui {
    Q_OBJECT
public:
    // Validated entries, in checking order.
    enum Entry { kForcedCrc = 0, kPreTapDac, kDatTapDac, kPostTapDac, kCrcInit, kEntryCount };

    Qvz_MGTTransmitterGui(Qvz_MGTTransmitter* page, QWidget* parent);
    ~Qvz_MGTTransmitterGui() override;

    Qvz_MGTTXWidget* Form() const { return m_pForm; }

    void LoadComboBoxes(Qvz_Block* block) override;
    void DataToWidgets() override;
    void WidgetsToData() override;
    void UpdateCrcControls();
    // A null block means the page's active block.
    void UpdateEncodingControls(Qvz_Block* block);

public slots:
    void onActive() override { Qvz_MGTPageGui::onActive(); }
    bool onCancel() override { return Qvz_MGTPageGui::onCancel(); }
    bool onBack() override { return Qvz_MGTPageGui::onBack(); }
    bool onNext() override { return Qvz_MGTPageGui::onNext(); }
    bool onFinish() override { return Qvz_MGTPageGui::onFinish(); }
    void onMoreInfo() override { Qvz_MGTPageGui::onMoreInfo(); }
    void init() override { Qvz_MGTPageGui::init(); }
    void OnRadioEncoding();
    void OnCheckPostDriver();
    void OnCheckPreDriver();
    void OnCheckUseCrc();
    // The validators refuse bad characters while the user types; these have
    // nothing left to do.
    void Validate_leCRCValue() {}
    void ValidateLE_ALL() {}

protected:
    bool ReadPage() override;
    bool WritePage() override;
    void UpdateControls() override;

private:
    Qvz_MGTTXWidget* m_pForm = nullptr;
    Qvz_MGTTransmitter* m_pPage = nullptr;
};
