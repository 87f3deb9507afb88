#include "Tsy_EditBufDlgUI.h"

#include <QKeySequence>

Tsy_EditBufDlgUI::Tsy_EditBufDlgUI(QWidget* parent) : QWidget(parent)
{
    setupUi(this);
    // "Clock &Mux" and "&More Info" share M, "&Local &Routing" and
    // "&Lowskewline" share L: the buffer types keep their letters, More Info
    // takes the help key, and Lowskewline (never selectable) none.
    RadioButtonBufg->setShortcut(QKeySequence(Qt::ALT | Qt::Key_G));
    RadioButtonBufgce->setShortcut(QKeySequence(Qt::ALT | Qt::Key_E));
    RadioButtonBufgmux->setShortcut(QKeySequence(Qt::ALT | Qt::Key_M));
    RadioButtonBufgctrl->setShortcut(QKeySequence(Qt::ALT | Qt::Key_X));
    RadioButtonBufgmuxTal4->setShortcut(QKeySequence(Qt::ALT | Qt::Key_T));
    RadioButtonLocalRouting->setShortcut(QKeySequence(Qt::ALT | Qt::Key_L));
    RadioButtonLowskewline->setShortcut(QKeySequence());
    PushButtonOk->setShortcut(QKeySequence(Qt::ALT | Qt::Key_O));
    PushButtonCancel->setShortcut(QKeySequence(Qt::ALT | Qt::Key_C));
    PushButtonDelete->setShortcut(QKeySequence(Qt::ALT | Qt::Key_D));
    PushButtonMoreInfo->setShortcut(QKeySequence(Qt::Key_F1));
    PushButtonMoreInfo->setToolTip("Open the help page of this dialog (F1)");
    // The title names the pin and changes with it: room for the longest.
    GroupBoxBufferType->setMinimumWidth(
        GroupBoxBufferType->fontMetrics().horizontalAdvance("Select buffer for PMCD pin U2 CLKA1D8") + 24);
    LineEditI0Sig->setToolTip("The net on the buffer's input, named after its source");
    LineEditI1Sig->setToolTip("The net on the buffer's I1 input, named after its source");
    LineEditO->setToolTip("The signal the buffer drives; leave it empty for the default name");
}
