#pragma once
// The Receiver Channel Bonding Setup form: the designer form's controls,
// public as the controller and the page set them directly.

#include "ui_Qvz_MGTRCBWidget.h"

#include <QDialog>

class Qvz_MGTRCBWidget : public QDialog, public Ui::Qvz_MGTRCBWidget {
    Q_OBJECT
public:
    explicit Qvz_MGTRCBWidget(QWidget* parent = nullptr, const char* name = nullptr,
                              bool modal = false, Qt::WindowFlags fl = {});
    ~Qvz_MGTRCBWidget() override;

    // Sets the texts again; the length list goes back to its placeholder item.
    void languageChange();
};
