#pragma once
// The wizard base of the host framework. A plug-in derives its wizard from
// it; the host fills in the context (part, design database, message stream,
// flags), then runs it in GUI or batch mode.

#include "port/StringBase.h"

#include <functional>
#include <vector>

class Gq_Wizard;
class Gq_WizardPage;
class Tsy_Block;
class Tsy_WizData;
class Tsy_WizPage;
namespace Port {
class Stream;
}

// Everything the host tells a wizard about the design it works on.
struct Tsy_WizContext {
    StringBase partName;
    StringBase familyName;
    StringBase deviceName;
    StringBase devicePrefix;
    StringBase speedGrade;
    StringBase dcmPrimName;
    StringBase moduleName;
    StringBase designVersion; // version string of the tool that wrote the loaded design
    std::vector<StringBase> deviceTraits;
    Tsy_WizData* data = nullptr;
    Port::Stream* stream = nullptr;

    bool messageFlag = false;         // passed along with messages issued without a page
    bool performanceModeKeys = false; // speed keys carry MS_/MR_; ODDR flip-flops
    bool loadedDesign = false;        // the design came from a file or from settings
    bool defaultSetup = false;        // a new design starts from the default setup
    bool retarget = false;            // the loaded design was made for another family
    bool pmcdFamily = false;          // the family has phase-matched clock dividers
    bool bufgctrlFamily = false;      // the family has BUFGCTRL and its clock muxes
    bool bufgmuxCtrlFamily = false;   // the family's mux primitive is BUFGMUX_CTRL
};

class Tsy_WizMain {
public:
    static constexpr int kPageSlots = 12;

    Tsy_WizMain(const StringBase& keyword, bool batch);
    virtual ~Tsy_WizMain();
    Tsy_WizMain(const Tsy_WizMain& other);
    Tsy_WizMain& operator=(const Tsy_WizMain& other);

    virtual int Run();
    virtual int RunGuiMode();
    virtual int RunBatchMode();
    virtual bool CreateGuiDlgs(Gq_Wizard* wizard);
    virtual bool GoBackFromSummary();
    virtual bool DoFinishAtSummaryStart();
    virtual int Finish();
    virtual bool CustomizeGui(Gq_Wizard* wizard);
    virtual bool InstantiatePages();

    // Builds the GUI of the instantiated pages into the window, with the
    // summary page after the last one (RunGuiMode does this, then runs it).
    bool PrepareGui(Gq_Wizard* window);

    // Batch settings name blocks by the wizard's own targets ("dcm", "pll"
    // ...); the plug-in resolves them. Null with a reason when it cannot.
    virtual Tsy_Block* ResolveTarget(const StringBase& target, StringBase& reason);

    void SetContext(const Tsy_WizContext& context);
    const Tsy_WizContext& Context() const { return ctx_; }

    const StringBase& GetKeyword() const { return keyword_; }
    bool IsBatch() const { return batch_; }
    void SetBatch(bool batch) { batch_ = batch; }
    bool GetMessageFlag() const { return ctx_.messageFlag; }
    bool IsPerformanceModeKeys() const { return ctx_.performanceModeKeys; }
    bool IsLoadedDesign() const { return ctx_.loadedDesign; }
    bool IsDefaultSetup() const { return ctx_.defaultSetup; }
    bool IsRetarget() const { return ctx_.retarget; }
    bool IsPmcdFamily() const { return ctx_.pmcdFamily; }
    bool IsBufgctrlFamily() const { return ctx_.bufgctrlFamily; }
    bool IsBufgmuxCtrlFamily() const { return ctx_.bufgmuxCtrlFamily; }
    const StringBase& GetPartName() const { return ctx_.partName; }
    const StringBase& GetFamilyName() const { return ctx_.familyName; }
    const StringBase& GetSpeedGrade() const { return ctx_.speedGrade; }
    const StringBase& GetModuleName() const { return ctx_.moduleName; }
    const StringBase& GetDesignVersion() const { return ctx_.designVersion; }
    Tsy_WizData* GetWizData() const { return ctx_.data; }
    Port::Stream* GetStream() const { return ctx_.stream; }
    // The DCM primitive type of the device's family.
    StringBase GetDCMPrimName() const { return ctx_.dcmPrimName; }
    // The device name without its family prefix ("da1").
    StringBase GetDeviceNoPrefix() const;
    bool HasDeviceTrait(const StringBase& trait) const;

    Tsy_WizPage* GetPage(int slot) const;
    Gq_WizardPage* GetSummaryPage() const { return summaryPage_; }
    void SetSummaryPage(Gq_WizardPage* page) { summaryPage_ = page; }

    // Opens a help topic in GUI mode; false in batch mode or for an unknown key.
    virtual bool ShowHelp(const StringBase& topicKey);
    Gq_Wizard* GetWindow() const { return window_; }

    // What the host does once Finish succeeded (write the design files), and
    // the files it will write, for the summary page. Set by the host.
    void SetOutputHooks(std::function<bool(StringBase& error)> write,
                        std::function<std::vector<StringBase>()> plannedFiles);
    // Runs before the pages in batch mode (the host's settings); false stops.
    void SetBeforePagesHook(std::function<bool()> hook) { beforePages_ = std::move(hook); }

protected:
    void SetPage(int slot, Tsy_WizPage* page);
    void DeletePages();
    // Finish, then the host's output; messages tell why it failed.
    bool FinishAndWrite();

private:
    StringBase keyword_;
    bool batch_;
    Tsy_WizContext ctx_;
    Tsy_WizPage* pages_[kPageSlots] = {};
    Gq_WizardPage* summaryPage_ = nullptr;
    Gq_Wizard* window_ = nullptr;
    std::function<bool(StringBase&)> write_;
    std::function<std::vector<StringBase>()> plannedFiles_;
    std::function<bool()> beforePages_;
    bool ownsPages_ = true;
};
