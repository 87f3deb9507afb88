#include "Tsy_AdvancedDlgUI.h"

Tsy_AdvancedDlgUI::Tsy_AdvancedDlgUI(QWidget* parent) : QWidget(parent)
{
    setupUi(this);
}

Tsy_AdvancedDlgUI::~Tsy_AdvancedDlgUI() = default;
