#include "run/Tsy_HostSession.h"

#include "db/Tsy_WizData.h"
#include "design/Tsy_DesignFile.h"
#include "design/Tsy_OutputSet.h"
#include "hdl/Tsy_HdlNames.h"
#include "hdl/Tsy_HdlWriter.h"
#include "lib/Tsy_DataDir.h"
#include "lib/Tsy_DeviceCatalog.h"
#include "lib/Tsy_PrimitiveLibrary.h"
#include "port/Exception.h"
#include "run/Tsy_PluginLoader.h"
#include "run/Tsy_WizardCatalog.h"
#include "wiz/Port_Stream.h"
#include "wiz/Tsy_WizMain.h"

#include <cerrno>
#include <cstring>
#include <sys/stat.h>

namespace {

// Creates the folder and its missing parents.
bool makeDirectories(const std::string& path, std::string& error)
{
    if (path.empty() || Tsy_IsDirectory(path))
        return true;
    size_t slash = path.find_last_of('/');
    if (slash != std::string::npos && slash > 0 && !makeDirectories(path.substr(0, slash), error))
        return false;
    if (::mkdir(path.c_str(), 0755) != 0 && errno != EEXIST) {
        error = path + ": cannot create the output folder: " + std::strerror(errno);
        return false;
    }
    return true;
}

bool parseOnOff(const std::string& value, bool& on)
{
    StringBase v(value);
    if (v.EqualsNoCase("on") || v.EqualsNoCase("true") || v == "1") {
        on = true;
        return true;
    }
    if (v.EqualsNoCase("off") || v.EqualsNoCase("false") || v == "0") {
        on = false;
        return true;
    }
    return false;
}

} // namespace

bool Tsy_ParseSetting(const std::string& text, bool pinSetting, Tsy_Setting& out, std::string& error)
{
    const char* shape = pinSetting ? "TARGET.PIN=on|off" : "TARGET.ATTR=VALUE or TARGET.PIN.ATTR=VALUE";
    size_t eq = text.find('=');
    if (eq == std::string::npos || eq == 0) {
        error = "'" + text + "' is not of the form " + shape;
        return false;
    }
    std::string left = text.substr(0, eq);
    out = Tsy_Setting();
    out.value = text.substr(eq + 1);
    size_t dot = left.find('.');
    if (dot == std::string::npos || dot == 0 || dot + 1 == left.size()) {
        error = "'" + text + "' is not of the form " + shape;
        return false;
    }
    out.target = left.substr(0, dot);
    std::string rest = left.substr(dot + 1);
    size_t dot2 = rest.find('.');
    if (pinSetting) {
        out.pin = rest;
        if (dot2 != std::string::npos) {
            error = "'" + text + "' is not of the form " + shape;
            return false;
        }
        bool on = false;
        if (!parseOnOff(out.value, on)) {
            error = "'" + text + "': the pin state must be on or off";
            return false;
        }
        return true;
    }
    if (dot2 == std::string::npos) {
        out.name = rest;
    } else {
        out.pin = rest.substr(0, dot2);
        out.name = rest.substr(dot2 + 1);
        if (out.pin.empty() || out.name.empty() || out.name.find('.') != std::string::npos) {
            error = "'" + text + "' is not of the form " + shape;
            return false;
        }
    }
    return true;
}

std::unique_ptr<Tsy_WizData> Tsy_NewDesignFor(const Tsy_PartInfo& part)
{
    auto data = std::make_unique<Tsy_WizData>(Tsy_PrimitiveLibrary::Instance());
    for (const auto& t : part.family->templates)
        data->AddTemplateBlock(t);
    return data;
}

Tsy_WizContext Tsy_ContextForPart(const Tsy_PartInfo& part)
{
    const Tsy_FamilyInfo& fam = *part.family;
    Tsy_WizContext ctx;
    ctx.partName = part.part;
    ctx.familyName = fam.key;
    ctx.deviceName = part.device;
    ctx.devicePrefix = fam.prefix;
    ctx.speedGrade = part.speedGrade;
    ctx.dcmPrimName = fam.dcmPrimitive;
    for (const auto& t : part.deviceInfo->traits)
        ctx.deviceTraits.push_back(t);
    ctx.performanceModeKeys = fam.Has("performance_modes");
    ctx.pmcdFamily = fam.Has("pmcd");
    ctx.bufgctrlFamily = fam.Has("bufgctrl");
    ctx.bufgmuxCtrlFamily = fam.Has("bufgmux_ctrl");
    ctx.defaultSetup = true;
    return ctx;
}

Tsy_HostSession::Tsy_HostSession(Port::Stream& stream) : stream_(stream) {}

Tsy_HostSession::~Tsy_HostSession() = default;

int Tsy_HostSession::Prepare(const Tsy_RunOptions& options, std::string& error)
{
    options_ = options;
    try {
        if (!checkOptions(options, error) || !makeDatabase(error) || !makeWizard(error))
            return kUsage;
    } catch (const Port::Exception& e) {
        error = e.what();
        return kUsage;
    }
    return kOk;
}

namespace {

// Empty when the module name may be written as both a Verilog module and a
// VHDL entity, else why not.
std::string moduleNameProblem(const std::string& module)
{
    std::string problem = Tsy_HdlNameProblem(module);
    if (!problem.empty())
        return "not a legal Verilog and VHDL name: it " + problem;
    // The module would clash with the primitives it instantiates (VHDL
    // names ignore case).
    if (Tsy_PrimitiveLibrary::Instance().FindNoCase(module))
        return "the name of a library primitive; choose another module name";
    return std::string();
}

bool checkSettingsShape(const Tsy_RunOptions& o, std::string& error)
{
    Tsy_Setting s;
    for (const auto& text : o.sets)
        if (!Tsy_ParseSetting(text, false, s, error)) {
            error = "--set " + error;
            return false;
        }
    for (const auto& text : o.pins)
        if (!Tsy_ParseSetting(text, true, s, error)) {
            error = "--pin " + error;
            return false;
        }
    return true;
}

} // namespace

// Options win over what the design file says; the module name falls back to
// the file's, then to the default.
bool Tsy_HostSession::readDesignHeader(const Tsy_RunOptions& o, std::string& error)
{
    Tsy_DesignHeader header;
    if (!o.designFile.empty()) {
        header = Tsy_DesignFile::ReadHeader(o.designFile);
        loadedVersion_ = header.version.str();
        Tsy_PartInfo loaded;
        loadedFamily_ = Tsy_DeviceCatalog::Instance().FindPart(header.part.str(), loaded) ? loaded.family->key : "";
    }
    wizardKey_ = o.wizard.empty() ? header.wizard.str() : o.wizard;
    part_ = o.part.empty() ? header.part.str() : o.part;
    module_ = !o.module.empty() ? o.module : !header.module.IsEmpty() ? header.module.str() : kDefaultModule;
    if (!o.designFile.empty() && !o.wizard.empty() && !StringBase(o.wizard).EqualsNoCase(header.wizard.str())) {
        error = "--wizard " + o.wizard + ": " + o.designFile + " is a '" + header.wizard.str() + "' design";
        return false;
    }
    if (wizardKey_.empty() || part_.empty()) {
        error = "give a design file, or both --wizard and --part";
        return false;
    }
    return true;
}

bool Tsy_HostSession::checkWizardAndPart(std::string& error)
{
    const Tsy_WizardInfo* info = wizards_->Find(wizardKey_);
    if (!info) {
        error = "--wizard " + wizardKey_ + ": unknown wizard type (see 'pendra wizards')";
        return false;
    }
    wizardKey_ = info->key;
    Tsy_PartInfo part;
    if (!Tsy_DeviceCatalog::Instance().FindPart(part_, part)) {
        error = "--part " + part_ + ": unknown part (see 'pendra parts')";
        return false;
    }
    part_ = part.part;
    std::string missing = Tsy_WizardCatalog::MissingCapability(*info, *part.family);
    if (!missing.empty()) {
        error = "--wizard " + wizardKey_ + ": the " + part.family->name + " family of part " + part_ +
                " cannot build it (it has no " + missing + ")";
        return false;
    }
    return true;
}

bool Tsy_HostSession::checkOptions(const Tsy_RunOptions& o, std::string& error)
{
    wizards_ = Tsy_WizardCatalog::LoadFile(Tsy_DataFile("wizards.json"));
    if (!readDesignHeader(o, error) || !checkWizardAndPart(error))
        return false;
    std::string problem = moduleNameProblem(module_);
    if (!problem.empty()) {
        error = "--module " + module_ + ": " + problem;
        return false;
    }
    return checkSettingsShape(o, error);
}

bool Tsy_HostSession::makeDatabase(std::string&)
{
    Tsy_PartInfo part;
    Tsy_DeviceCatalog::Instance().FindPart(part_, part);
    data_ = Tsy_NewDesignFor(part);
    if (options_.designFile.empty())
        return true;
    Tsy_DesignFile::Load(options_.designFile, *data_);
    // The netlist of an earlier Finish is built anew by the next one.
    for (const auto& b : data_->Blocks())
        if (b->IsGenerated())
            b->active = false;
    return true;
}

bool Tsy_HostSession::makeWizard(std::string& error)
{
    const Tsy_PluginLoader* loader = Tsy_PluginLoader::Shared(wizards_->PluginFile(), error);
    if (!loader)
        return false;
    wizard_ = loader->Create(wizardKey_, options_.batch);
    if (!wizard_) {
        error = "--wizard " + wizardKey_ + ": this wizard type is not available in this build";
        return false;
    }
    Tsy_PartInfo part;
    Tsy_DeviceCatalog::Instance().FindPart(part_, part);
    Tsy_WizContext ctx = Tsy_ContextForPart(part);
    ctx.moduleName = module_;
    ctx.designVersion = loadedVersion_;
    ctx.data = data_.get();
    ctx.stream = &stream_;
    ctx.loadedDesign = !options_.designFile.empty() || !options_.sets.empty() || !options_.pins.empty();
    ctx.defaultSetup = !ctx.loadedDesign;
    ctx.retarget = !options_.designFile.empty() && !loadedFamily_.empty() && loadedFamily_ != part.family->key;
    wizard_->SetContext(ctx);
    wizard_->SetBeforePagesHook([this] { return applySettings(); });
    wizard_->SetOutputHooks([this](StringBase& why) {
        std::string e;
        bool ok = WriteOutputs(e);
        why = e;
        return ok;
    },
                            [this] {
                                std::vector<StringBase> out;
                                for (const auto& p : PlannedFiles())
                                    out.push_back(p);
                                return out;
                            });
    return true;
}

bool Tsy_HostSession::applySetting(const std::string& text, bool pinSetting)
{
    const std::string option = pinSetting ? "--pin" : "--set";
    auto fail = [&](const std::string& why) {
        error_ = option + " " + text + ": " + why;
        return false;
    };
    Tsy_Setting s;
    Tsy_ParseSetting(text, pinSetting, s, error_);
    StringBase reason;
    Tsy_Block* block = wizard_->ResolveTarget(s.target, reason);
    if (!block)
        return fail(reason.str());
    Tsy_Pin* pin = s.pin.empty() ? nullptr : block->GetNamedPin(s.pin);
    if (!s.pin.empty() && !pin)
        return fail(block->GetType().str() + " has no pin " + s.pin);
    if (pinSetting) {
        bool on = false;
        parseOnOff(s.value, on);
        pin->SetIsActive(on);
    } else if (pin) {
        pin->SetAttributeValue(s.name, s.value);
    } else {
        // Block attributes must be ones the primitive knows: a typo would
        // otherwise be stored silently and change nothing.
        if (!block->GetNamedAttribute(s.name) && !(block->GetDef() && block->GetDef()->FindAttr(s.name)))
            return fail(block->GetType().str() + " has no attribute " + s.name);
        block->SetAttributeValue(s.name, s.value);
        block->SetAttributeIsActive(s.name, true);
    }
    return true;
}

bool Tsy_HostSession::applySettings()
{
    for (const auto& text : options_.sets)
        if (!applySetting(text, false))
            return false;
    for (const auto& text : options_.pins)
        if (!applySetting(text, true))
            return false;
    return true;
}

int Tsy_HostSession::Run()
{
    if (!wizard_)
        return kUsage;
    int rc = wizard_->Run();
    if (rc == 2)
        return kUsage;
    return rc == 0 ? kOk : kFailed;
}

std::vector<std::string> Tsy_HostSession::PlannedFiles() const
{
    std::string base = (options_.outDir.empty() ? "." : options_.outDir) + "/" + module_;
    return {base + ".tsw", base + ".v", base + ".vhd", base + "_inst.vt", base + "_inst.vht"};
}

bool Tsy_HostSession::WriteOutputs(std::string& error)
{
    if (!makeDirectories(options_.outDir, error))
        return false;
    Tsy_DesignHeader header;
    header.wizard = wizardKey_;
    header.part = part_;
    header.module = module_;
    header.version = PENDRA_VERSION;
    std::vector<std::string> paths = PlannedFiles();
    // The HDL is made first: a netlist it refuses leaves every file as it was.
    std::vector<std::string> banner = {
        module_ + ": clock network for part " + part_ + ", made by the '" + wizardKey_ + "' wizard of pendra " +
            PENDRA_VERSION + ".",
        "The design is kept in " + module_ + ".tsw: change it there and generate again rather than",
        "editing this file."};
    Tsy_HdlFiles hdl;
    if (!Tsy_WriteHdl(*data_, module_, banner, hdl, error))
        return false;
    Tsy_OutputSet files;
    files.Add(paths[0], Tsy_DesignFile::ToText(header, *data_));
    files.Add(paths[1], hdl.verilog);
    files.Add(paths[2], hdl.vhdl);
    files.Add(paths[3], hdl.verilogTemplate);
    files.Add(paths[4], hdl.vhdlTemplate);
    if (!files.Commit(error))
        return false;
    written_ = files.Paths();
    return true;
}
