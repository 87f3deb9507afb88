#include "support/BatchRun.h"

namespace {

const nlohmann::json* activeDcm(const nlohmann::json& design)
{
    if (design.is_null())
        return nullptr;
    for (const auto& b : design["blocks"])
        if (b["type"].get<std::string>().rfind("DCM", 0) == 0 && b.value("active", false))
            return &b;
    return nullptr;
}

// A saved attribute is a bare string, or an object when it is inactive.
std::string valueOf(const nlohmann::json& v)
{
    return v.is_string() ? v.get<std::string>() : v["value"].get<std::string>();
}

} // namespace

std::string GenerateRun::DcmAttr(const std::string& name) const
{
    const nlohmann::json* dcm = activeDcm(design);
    if (!dcm || !dcm->contains("attributes") || !(*dcm)["attributes"].contains(name))
        return "(none)";
    return valueOf((*dcm)["attributes"][name]);
}

bool GenerateRun::DcmPinOn(const std::string& pin) const
{
    if (const nlohmann::json* dcm = activeDcm(design))
        for (const auto& p : (*dcm)["pins"])
            if (p["name"] == pin)
                return p.value("active", false);
    return false;
}

Records GenerateRun::DcmPinRecords(const std::string& pin) const
{
    Records out;
    if (const nlohmann::json* dcm = activeDcm(design))
        for (const auto& p : (*dcm)["pins"])
            if (p["name"] == pin && p.contains("attributes"))
                for (const auto& [k, v] : p["attributes"].items())
                    if (k.rfind("TSY_CLKBUF", 0) == 0)
                        out[k] = valueOf(v);
    return out;
}

std::string PendraProgram()
{
    return std::string(PENDRA_BIN_DIR) + "/pendra";
}

GenerateRun Generate(const std::string& args, const std::string& module)
{
    TempDir dir;
    GenerateRun run;
    run.result = RunCommand(PendraProgram() + " generate " + args + " --module " + module + " -o " + dir.Path());
    std::string text = ReadTextFile(dir.File(module + ".tsw"));
    if (!text.empty())
        run.design = nlohmann::json::parse(text);
    return run;
}
