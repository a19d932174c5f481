#include "Qvz_MGTRCDWidget.h"

Qvz_MGTRCDWidget::Qvz_MGTRCDWidget(QWidget* parent, const char* name, bool modal,
                                   Qt::WindowFlags fl)
    : QDialog(parent, fl) {
    if (name)
        setObjectName(QString::fromUtf8(name));
    setModal(modal);
    setupUi(this);
    // Button ids follow the order in which the buttons were made.
    bgPCDButtons->setId(rbDynamicPCD, 0);
    bgPCDButtons->setId(rbAlwaysPCD, 1);
    bgPCDButtons->setId(rbDisablePCD, 2);
    bgMCDButtons->setId(rbDynamicMCD, 0);
    bgMCDButtons->setId(rbAlwaysMCD, 1);
    bgMCDButtons->setId(rbDisableMCD, 2);
    m_designedAlignItems = cbAlign->count();
}

Qvz_MGTRCDWidget::~Qvz_MGTRCDWidget() = default;

void Qvz_MGTRCDWidget::languageChange() {
    // The page refills cbAlign from the block; start again from the designed
    // items, whose texts retranslateUi sets by position.
    cbAlign->clear();
    for (int n = 0; n < m_designedAlignItems; ++n)
        cbAlign->addItem(QString());
    retranslateUi(this);
}
