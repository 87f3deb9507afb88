#include "Tsy_ClockBufDlgUI.h"

#include <QKeySequence>
#include <QLabel>
#include <QPushButton>
#include <QRadioButton>

Tsy_ClockBufDlgUI::Tsy_ClockBufDlgUI(QWidget* parent) : QWidget(parent)
{
    setupUi(this);
    QLabel* const i0[kRows] = {TextLabelPinI0Row1,  TextLabelPinI0Row2,  TextLabelPinI0Row3,  TextLabelPinI0Row4,
                               TextLabelPinI0Row5,  TextLabelPinI0Row6,  TextLabelPinI0Row7,  TextLabelPinI0Row8,
                               TextLabelPinI0Row9,  TextLabelPinI0Row10, TextLabelPinI0Row11, TextLabelPinI0Row12,
                               TextLabelPinI0Row13, TextLabelPinI0Row14, TextLabelPinI0Row15, TextLabelPinI0Row16};
    QLabel* const i1[kRows] = {TextLabelPinI1Row1,  TextLabelPinI1Row2,  TextLabelPinI1Row3,  TextLabelPinI1Row4,
                               TextLabelPinI1Row5,  TextLabelPinI1Row6,  TextLabelPinI1Row7,  TextLabelPinI1Row8,
                               TextLabelPinI1Row9,  TextLabelPinI1Row10, TextLabelPinI1Row11, TextLabelPinI1Row12,
                               TextLabelPinI1Row13, TextLabelPinI1Row14, TextLabelPinI1Row15, TextLabelPinI1Row16};
    QPushButton* const edit[kRows] = {
        PushButtonEditRow1,  PushButtonEditRow2,  PushButtonEditRow3,  PushButtonEditRow4,
        PushButtonEditRow5,  PushButtonEditRow6,  PushButtonEditRow7,  PushButtonEditRow8,
        PushButtonEditRow9,  PushButtonEditRow10, PushButtonEditRow11, PushButtonEditRow12,
        PushButtonEditRow13, PushButtonEditRow14, PushButtonEditRow15, PushButtonEditRow16};
    for (int r = 0; r < kRows; ++r) {
        i0_[r] = i0[r];
        i1_[r] = i1[r];
        edit_[r] = edit[r];
    }
    // Both mode labels underline a "u"; each radio button gets a key of its
    // own so that neither accelerator is ambiguous.
    RadioUseBufgs->setShortcut(QKeySequence(Qt::ALT | Qt::Key_G));
    RadioUseBufgs->setToolTip("One Global Buffer for every selected output (Alt+G)");
    RadioUseGrid->setShortcut(QKeySequence(Qt::ALT | Qt::Key_U));
    RadioUseGrid->setToolTip("Choose the buffers of each output row by row (Alt+U)");
    PushButtonAddBuf->setShortcut(QKeySequence(Qt::ALT | Qt::Key_A));
    PushButtonAddBuf->setToolTip("Add another buffer to one of the outputs (Alt+A)");
}

QLabel* Tsy_ClockBufDlgUI::RowI0(int r) const
{
    return r >= 1 && r <= kRows ? i0_[r - 1] : nullptr;
}

QLabel* Tsy_ClockBufDlgUI::RowI1(int r) const
{
    return r >= 1 && r <= kRows ? i1_[r - 1] : nullptr;
}

QPushButton* Tsy_ClockBufDlgUI::RowButton(int r) const
{
    return r >= 1 && r <= kRows ? edit_[r - 1] : nullptr;
}
