#include "wiz/Tsy_WizPage.h"

#include "wiz/Port_Stream.h"
#include "wiz/Tsy_WizMain.h"

#include <QComboBox>

Tsy_WizPage::Tsy_WizPage(Tsy_WizMain* wizard) : wizard_(wizard) {}

Tsy_WizPage::~Tsy_WizPage() = default;

void Tsy_WizPage::IssueMessage(const StringBase& text, bool isError, bool flag2, bool flag3)
{
    Port::Stream* stream = wizard_ ? wizard_->GetStream() : nullptr;
    if (!stream)
        return;
    if (wizard_->IsBatch())
        stream->Log(text, isError);
    else
        stream->Message(text, isError, flag2, flag3);
}

int Tsy_WizPage::IssueYesNoQuestion(const StringBase& question, const StringBase& second)
{
    Port::Stream* stream = wizard_ ? wizard_->GetStream() : nullptr;
    return stream ? stream->Ask(question, second) : 1;
}

bool Tsy_WizPage::InvokeMoreInfo(const StringBase& topicKey)
{
    return wizard_ && wizard_->ShowHelp(topicKey);
}

void Tsy_WizPage::DoMessage(const StringBase& text, bool batch, Port::Stream* stream, bool isError, bool messageFlag,
                            bool flag3)
{
    if (!stream)
        return;
    if (batch)
        stream->Log(text, isError);
    else
        stream->Message(text, isError, messageFlag, flag3);
}

bool Tsy_WizPage::SetComboBoxText(QComboBox* combo, const StringBase& text)
{
    if (!combo)
        return false;
    int index = combo->findText(QString::fromStdString(text.str()), Qt::MatchFixedString);
    if (index < 0)
        return false;
    combo->setCurrentIndex(index);
    return true;
}
