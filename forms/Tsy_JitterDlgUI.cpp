#include "Tsy_JitterDlgUI.h"

Tsy_JitterDlgUI::Tsy_JitterDlgUI(QWidget* parent) : QWidget(parent)
{
    setupUi(this);
}
