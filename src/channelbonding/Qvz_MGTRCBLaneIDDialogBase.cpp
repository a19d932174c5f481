#include "Qvz_MGTRCBLaneIDDialogBase.h"

Qvz_MGTRCBLaneIDDialogBase::Qvz_MGTRCBLaneIDDialogBase(QWidget* parent, const char* name,
                                                       bool modal, Qt::WindowFlags fl)
    : QDialog(parent, fl) {
    if (name)
        setObjectName(QString::fromUtf8(name));
    setModal(modal);
    setupUi(this);
}

Qvz_MGTRCBLaneIDDialogBase::~Qvz_MGTRCBLaneIDDialogBase() = default;

void Qvz_MGTRCBLaneIDDialogBase::languageChange() {
    retranslateUi(this);
}
