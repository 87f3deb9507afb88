#pragma once
// The form of the View/Edit Buffer dialog: the buffer types, the inputs and
// port signal names around the picture of the chosen buffer, and the buttons.

#include "ui_Tsy_EditBufDlgUI.h"

#include <QWidget>

class Tsy_EditBufDlgUI : public QWidget, public Ui::Tsy_EditBufDlgUIForm {
    Q_OBJECT
public:
    explicit Tsy_EditBufDlgUI(QWidget* parent = nullptr);
};
