#pragma once
// The General Setup form: the DCM symbol with its pin boxes, the input clock,
// the sources, the phase shift and the divider.

#include "ui_Tsy_DCMgenSetupUI.h"

#include <QWidget>

class Tsy_DCMgenSetupUI : public QWidget, public Ui::Tsy_DCMgenSetupUIForm {
    Q_OBJECT
public:
    explicit Tsy_DCMgenSetupUI(QWidget* parent = nullptr);
    ~Tsy_DCMgenSetupUI() override;

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;
};
