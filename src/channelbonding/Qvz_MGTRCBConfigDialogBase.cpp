#include "Qvz_MGTRCBConfigDialogBase.h"

Qvz_MGTRCBConfigDialogBase::Qvz_MGTRCBConfigDialogBase(QWidget* parent, const char* name,
                                                       bool modal, Qt::WindowFlags fl)
    : QDialog(parent, fl) {
    if (name)
        setObjectName(QString::fromUtf8(name));
    setModal(modal);
    setupUi(this);
}

Qvz_MGTRCBConfigDialogBase::~Qvz_MGTRCBConfigDialogBase() = default;

void Qvz_MGTRCBConfigDialogBase::languageChange() {
    retranslateUi(this);
}
