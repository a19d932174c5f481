#include "Qvz_MGTRCBConfig11DialogBase.h"

Qvz_MGTRCBConfig11DialogBase::Qvz_MGTRCBConfig11DialogBase(QWidget* parent, const char* name,
                                                           bool modal, Qt::WindowFlags fl)
    : QDialog(parent, fl) {
    if (name)
        setObjectName(QString::fromUtf8(name));
    setModal(modal);
    setupUi(this);
}

Qvz_MGTRCBConfig11DialogBase::~Qvz_MGTRCBConfig11DialogBase() = default;

void Qvz_MGTRCBConfig11DialogBase::languageChange() {
    retranslateUi(this);
}
