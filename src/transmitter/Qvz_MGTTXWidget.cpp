#include "Qvz_MGTTXWidget.h"

#include <QtGlobal>

Qvz_MGTTXWidget::Qvz_MGTTXWidget(QWidget* parent, const char* name, bool modal, Qt::WindowFlags fl)
    : QDialog(parent, fl) {
    if (name)
        setObjectName(QString::fromUtf8(name));
    setModal(modal);
    setupUi(this);
    // Button ids follow the order in which the buttons were made.
    bgEncodingButtons->setId(rbDEC, 0);
    bgEncodingButtons->setId(rbSEC, 1);
    bgEncodingButtons->setId(rbDisableEncoding, 2);
    bgStaticEncodingControlButtons->setId(rbEnable8B10B, 0);
    bgStaticEncodingControlButtons->setId(rbEnable64, 1);
    QComboBox* const lists[5] = {cbOVS, cbCRCFormat, cbSOP, cbEOP, cbCRCwidth};
    for (int i = 0; i < 5; ++i)
        m_designedItems[i] = lists[i]->count();
}

Qvz_MGTTXWidget::~Qvz_MGTTXWidget() = default;

void Qvz_MGTTXWidget::languageChange() {
    // The page refills the lists from the block; start again from the
    // designed items, whose texts retranslateUi sets by position.
    QComboBox* const lists[5] = {cbOVS, cbCRCFormat, cbSOP, cbEOP, cbCRCwidth};
    for (int i = 0; i < 5; ++i) {
        lists[i]->clear();
        for (int n = 0; n < m_designedItems[i]; ++n)
            lists[i]->addItem(QString());
    }
    retranslateUi(this);
}

void Qvz_MGTTXWidget::rbStaticEncodingControlToggled(bool) {
    qWarning("Qvz_MGTTXWidget::rbStaticEncodingControlToggled(bool): Not implemented yet");
}
