#include "Qvz_MGTRCCWidget.h"

#include <QtGlobal>

Qvz_MGTRCCWidget::Qvz_MGTRCCWidget(QWidget* parent, const char* name, bool modal,
                                   Qt::WindowFlags fl)
    : QDialog(parent, fl) {
    if (name)
        setObjectName(QString::fromUtf8(name));
    setModal(modal);
    setupUi(this);
}

Qvz_MGTRCCWidget::~Qvz_MGTRCCWidget() = default;

void Qvz_MGTRCCWidget::languageChange() {
    // The page refills the list from the block; retranslateUi names the one
    // designed item by position.
    cbSeqLen->clear();
    cbSeqLen->addItem(QString());
    retranslateUi(this);
}

void Qvz_MGTRCCWidget::test() {
    qWarning("Qvz_MGTRCCWidget::test(): Not implemented yet");
}
