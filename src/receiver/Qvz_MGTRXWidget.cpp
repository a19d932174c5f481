#include "Qvz_MGTRXWidget.h"

Qvz_MGTRXWidget::Qvz_MGTRXWidget(QWidget* parent, const char* name, bool modal, Qt::WindowFlags fl)
    : QDialog(parent, fl) {
    if (name)
        setObjectName(QString::fromUtf8(name));
    setModal(modal);
    setupUi(this);
    // Button ids follow the order in which the buttons were made.
    bgDecodingButtons->setId(rbDisableDecoding, 0);
    bgDecodingButtons->setId(rbDDC, 1);
    bgDecodingButtons->setId(rbSDC, 2);
    bgStaticDecodingControlButtons->setId(rb8BDecoding, 0);
    bgStaticDecodingControlButtons->setId(rb64BDecoding, 1);
    QComboBox* const lists[3] = {cbRXIncr, cbRXThreshold, cbRxCRCwidth};
    for (int i = 0; i < 3; ++i)
        m_designedItems[i] = lists[i]->count();
}

Qvz_MGTRXWidget::~Qvz_MGTRXWidget() = default;

void Qvz_MGTRXWidget::languageChange() {
    // The page refills the lists from the block; start again from the
    // designed items, whose texts retranslateUi sets by position.
    QComboBox* const lists[3] = {cbRXIncr, cbRXThreshold, cbRxCRCwidth};
    for (int i = 0; i < 3; ++i) {
        lists[i]->clear();
        for (int n = 0; n < m_designedItems[i]; ++n)
            lists[i]->addItem(QString());
    }
    retranslateUi(this);
}
