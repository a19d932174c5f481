#include "GeneralSetupWidget.h"

#include <QButtonGroup>

GeneralSetupWidget::GeneralSetupWidget(QWidget* parent, const char* name, Qt::WindowFlags fl)
    : QWidget(parent, fl) {
    if (name)
        setObjectName(QString::fromUtf8(name));
    setupUi(this);
    // Button ids follow the order in which the buttons were made.
    QButtonGroup* const groups[] = {
        bgRefClkSelectionGT3Buttons, bgREFCLKButtons,   bgStaticControlButtons, bgBREFCLKButtons,
        bgStaticControlBButtons,     bgTXRefButtons,    bgRXRefButtons,         bgGT11ModeButtons,
        buttonGrpSingleMGTButtons,   bgImpedenceButtons};
    for (QButtonGroup* g : groups) {
        const QList<QAbstractButton*> buttons = g->buttons();
        for (int i = 0; i < buttons.size(); ++i)
            g->setId(buttons[i], i);
    }
}

GeneralSetupWidget::~GeneralSetupWidget() = default;

void GeneralSetupWidget::languageChange() {
    retranslateUi(this);
}
