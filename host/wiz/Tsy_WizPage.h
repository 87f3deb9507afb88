#pragma once
// The page base of the host framework: one logical page of a wizard, with the
// message operations every page uses.

#include "port/StringBase.h"

class Gq_WizardPage;
class QComboBox;
class QWidget;
class Tsy_WizMain;
namespace Port {
class Stream;
}

class Tsy_WizPage {
public:
    explicit Tsy_WizPage(Tsy_WizMain* wizard);
    virtual ~Tsy_WizPage();
    Tsy_WizPage(const Tsy_WizPage&) = delete;
    Tsy_WizPage& operator=(const Tsy_WizPage&) = delete;

    // Loads and stores the page without a form (batch mode).
    virtual bool ApplySilently() { return true; }
    // Creates the page's controller and its widget under the parent.
    virtual bool CreateGui(QWidget* parent) = 0;
    virtual Gq_WizardPage* GetGui() = 0;

    Tsy_WizMain* GetWizMain() const { return wizard_; }

    // Shows the text (GUI) or logs it (batch). isError tells errors from
    // notes; flag3 marks the multi-line range reports.
    void IssueMessage(const StringBase& text, bool isError, bool flag2, bool flag3);
    // Non-zero for Yes.
    int IssueYesNoQuestion(const StringBase& question, const StringBase& second);
    bool InvokeMoreInfo(const StringBase& topicKey);

    // For code without a page. With batch set the message is logged rather
    // than shown.
    static void DoMessage(const StringBase& text, bool batch, Port::Stream* stream, bool isError, bool messageFlag,
                          bool flag3);
    // Selects the combo entry with that text (case ignored); false when none.
    static bool SetComboBoxText(QComboBox* combo, const StringBase& text);

private:
    Tsy_WizMain* wizard_;
};
