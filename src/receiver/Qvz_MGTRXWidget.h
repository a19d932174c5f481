#pragma once
// The Receiver Setup form: the designer form's controls, public as the
// controller and the page set them directly.

#include "ui_Qvz_MGTRXWidget.h"

#include <QDialog>

class Qvz_MGTRXWidget : public QDialog, public Ui::Qvz_MGTRXWidget {
    Q_OBJECT
public:
    explicit Qvz_MGTRXWidget(QWidget* parent = nullptr, const char* name = nullptr,
                             bool modal = false, Qt::WindowFlags fl = {});
    ~Qvz_MGTRXWidget() override;

    // Sets the texts again and refills the lists with the designed items.
    void languageChange();

private:
    // Number of designed items per list, for languageChange.
    int m_designedItems[3] = {};
};
