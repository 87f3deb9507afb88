#pragma once
// The form of the Clock Buffers page: the mode radio buttons, Add Buffer and
// sixteen rows of (I0 label, I1 label, View/Edit button).

#include "ui_Tsy_ClockBufDlgUI.h"

#include <QWidget>

class QLabel;
class QPushButton;

class Tsy_ClockBufDlgUI : public QWidget, public Ui::Tsy_ClockBufDlgUIForm {
    Q_OBJECT
public:
    static constexpr int kRows = 16;

    explicit Tsy_ClockBufDlgUI(QWidget* parent = nullptr);

    // Row r, 1 to 16; null outside.
    QLabel* RowI0(int r) const;
    QLabel* RowI1(int r) const;
    QPushButton* RowButton(int r) const;

private:
    QLabel* i0_[kRows] = {};
    QLabel* i1_[kRows] = {};
    QPushButton* edit_[kRows] = {};
};
