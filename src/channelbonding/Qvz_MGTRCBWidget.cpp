#include "Qvz_MGTRCBWidget.h"

Qvz_MGTRCBWidget::Qvz_MGTRCBWidget(QWidget* parent, const char* name, bool modal,
                                   Qt::WindowFlags fl)
    : QDialog(parent, fl) {
    if (name)
        setObjectName(QString::fromUtf8(name));
    setModal(modal);
    setupUi(this);
    // Button ids follow the order in which the buttons were made.
    buttonGroup26Buttons->setId(IDC_RADIO_PRIMARY_ROW_TOP, 0);
    buttonGroup26Buttons->setId(IDC_RADIO_PRIMARY_ROW_BOTTOM, 1);
}

Qvz_MGTRCBWidget::~Qvz_MGTRCBWidget() = default;

void Qvz_MGTRCBWidget::languageChange() {
    // The page refills the list from the block; retranslateUi names the one
    // designed item by position.
    cbSeqLen->clear();
    cbSeqLen->addItem(QString());
    retranslateUi(this);
}
