#pragma once
// The Transmitter Setup form: the designer form's controls, public as the
// controller and the page set them directly.

#include "ui_Qvz_MGTTXWidget.h"

#include <QDialog>

class Qvz_MGTTXWidget : public QDialog, public Ui::Qvz_MGTTXWidget {
    Q_OBJECT
public:
    explicit Qvz_MGTTXWidget(QWidget* parent = nullptr, const char* name = nullptr,
                             bool modal = false, Qt::WindowFlags fl = {});
    ~Qvz_MGTTXWidget() override;

    // Sets the texts again and refills the lists with the designed items.
    void languageChange();

public slots:
    virtual void rbStaticEncodingControlToggled(bool);

private:
    // Number of designed items per list, for languageChange.
    int m_designedItems[5] = {};
};
