#pragma once
// The Advanced form of General Setup: deskew adjustment, startup wait, input
// divider, reset logic, reconfiguration pins and performance mode.

#include "ui_Tsy_AdvancedDlgUI.h"

#include <QWidget>

class Tsy_AdvancedDlgUI : public QWidget, public Ui::Tsy_AdvancedDlgUIForm {
    Q_OBJECT
public:
    explicit Tsy_AdvancedDlgUI(QWidget* parent = nullptr);
    ~Tsy_AdvancedDlgUI() override;
};
