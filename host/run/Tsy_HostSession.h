#pragma once
// One run of a wizard by the host: the options checked, the part's design
// database made (and a saved design loaded into it), the plug-in's wizard
// built and given its context, then run in batch or GUI mode; after a
// successful Finish the design files are written together.

#include "port/StringBase.h"

#include <memory>
#include <string>
#include <vector>

class Tsy_WizData;
class Tsy_WizMain;
class Tsy_WizardCatalog;
namespace Port {
class Stream;
}

struct Tsy_RunOptions {
    std::string designFile;
    std::string wizard;
    std::string part;
    std::string module;
    std::string outDir = ".";
    std::vector<std::string> sets; // TARGET.ATTR=VALUE or TARGET.PIN.ATTR=VALUE
    std::vector<std::string> pins; // TARGET.PIN=on|off
    bool batch = true;
};

class Tsy_HostSession {
public:
    enum ExitCode { kOk = 0, kFailed = 1, kUsage = 2 };
    static constexpr const char* kDefaultModule = "clkgen";

    explicit Tsy_HostSession(Port::Stream& stream);
    ~Tsy_HostSession();

    // kOk, or kUsage with one line in error naming the option or file at fault.
    int Prepare(const Tsy_RunOptions& options, std::string& error);
    // kOk, kFailed (a page or Finish failed: nothing written) or kUsage (a
    // setting names something the wizard does not have; see Error()).
    int Run();
    const std::string& Error() const { return error_; }

    Tsy_WizMain* Wizard() const { return wizard_.get(); }
    Tsy_WizData* Data() const { return data_.get(); }
    const std::vector<std::string>& WrittenFiles() const { return written_; }
    std::vector<std::string> PlannedFiles() const;
    // Writes the design files of the database as it stands.
    bool WriteOutputs(std::string& error);

private:
    bool checkOptions(const Tsy_RunOptions& options, std::string& error);
    bool readDesignHeader(const Tsy_RunOptions& options, std::string& error);
    bool checkWizardAndPart(std::string& error);
    bool makeDatabase(std::string& error);
    bool makeWizard(std::string& error);
    bool applySettings();
    bool applySetting(const std::string& text, bool pinSetting);

    Port::Stream& stream_;
    Tsy_RunOptions options_;
    std::string wizardKey_;
    std::string part_;
    std::string module_;
    std::string loadedFamily_;
    std::string loadedVersion_;
    std::unique_ptr<Tsy_WizardCatalog> wizards_;
    std::unique_ptr<Tsy_WizData> data_;
    std::unique_ptr<Tsy_WizMain> wizard_;
    std::vector<std::string> written_;
    std::string error_;
};

struct Tsy_PartInfo;
struct Tsy_WizContext;

// A new design database for the part: one inactive template block per clock
// primitive of its family.
std::unique_ptr<Tsy_WizData> Tsy_NewDesignFor(const Tsy_PartInfo& part);
// The context fields and flags that follow from the part alone.
Tsy_WizContext Tsy_ContextForPart(const Tsy_PartInfo& part);

// The parts of one setting option: "dcm.CLKIN_PERIOD=5" or "dcm.CLK0.TSY_CLKBUFTYPE1=BUFG".
struct Tsy_Setting {
    std::string target, pin, name, value;
};
// False with the reason when the text is not of that shape.
bool Tsy_ParseSetting(const std::string& text, bool pinSetting, Tsy_Setting& out, std::string& error);
