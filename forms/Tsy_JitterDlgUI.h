#pragma once
// The form of the Clock Frequency Synthesizer page: valid ranges, the inputs
// for the calculation and the generated output.

#include "ui_Tsy_JitterDlgUI.h"

#include <QWidget>

class Tsy_JitterDlgUI : public QWidget, public Ui::Tsy_JitterDlgUIForm {
public:
    explicit Tsy_JitterDlgUI(QWidget* parent = nullptr);
};
