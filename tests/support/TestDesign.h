#pragma once
// A wizard on a real design database for a catalogue part, wired the way the
// host wires it, with a recording message stream. Pages are driven through
// it in tests.

#include "db/Tsy_WizData.h"
#include "lib/Tsy_DeviceCatalog.h"
#include "wiz/Tsy_MessageStreams.h"
#include "wiz/Tsy_WizMain.h"
#include "wizard/Tsy_DCMwiz.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

class TestDesign {
public:
    // keyword: a wizard type ("dcm" ...); part: a catalogue part ("t5da1-1").
    TestDesign(const std::string& keyword, const std::string& part, bool batch = true);
    ~TestDesign();

    // Changes the wizard's context (flags, module name ...).
    void Configure(const std::function<void(Tsy_WizContext&)>& change);
    // A design loaded from a file or settings: loaded-design set, default-setup clear.
    void MarkLoaded();
    // What the host does first: pages made, speed data loaded.
    void Instantiate();

    Tsy_DCMwiz& Wizard() { return *wizard_; }
    Tsy_WizData& Data() { return *data_; }
    Tsy_RecordingStream& Stream() { return stream_; }
    const Tsy_PartInfo& Part() const { return part_; }

private:
    Tsy_PartInfo part_;
    Tsy_RecordingStream stream_;
    std::unique_ptr<Tsy_WizData> data_;
    std::unique_ptr<Tsy_DCMwiz> wizard_;
};

// The wizard's page of that kind serving DCM instance inst; null when none.
template <typename Page>
Page* FindPage(Tsy_DCMwiz& wizard, int inst = 1)
{
    for (int i = 0; i < Tsy_WizMain::kPageSlots; ++i)
        if (auto* p = dynamic_cast<Page*>(wizard.GetPage(i)); p && p->GetInstNum() == inst)
            return p;
    return nullptr;
}

// Messages as plain strings, for comparing whole lists.
std::vector<std::string> Texts(const std::vector<StringBase>& messages);
bool Contains(const std::vector<std::string>& texts, const std::string& text);

// Reads a whole file; empty when it cannot.
std::string ReadTextFile(const std::string& path);

// A scratch folder removed with its contents when the object goes.
class TempDir {
public:
    TempDir();
    ~TempDir();
    const std::string& Path() const { return path_; }
    std::string File(const std::string& name) const { return path_ + "/" + name; }

private:
    std::string path_;
};

// Runs a command through the shell; the exit status and everything it wrote
// to standard output and standard error.
struct CommandResult {
    int status = -1;
    std::string out;
    std::string err;
};
CommandResult RunCommand(const std::string& command);
