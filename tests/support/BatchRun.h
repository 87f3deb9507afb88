#pragma once
// A whole batch run of pendra generate, and the design file it wrote read the
// way a designer reads it: the DCM's attributes and its pins' buffer records.

#include "support/TestDesign.h"

#include <nlohmann/json.hpp>

#include <map>
#include <string>

using Records = std::map<std::string, std::string>;

struct GenerateRun {
    CommandResult result;
    nlohmann::json design; // null when nothing was written

    bool Written() const { return !design.is_null(); }
    // An attribute of the first active DCM block; "(none)" when it has none.
    std::string DcmAttr(const std::string& name) const;
    bool DcmPinOn(const std::string& pin) const;
    // The "TSY_CLKBUF..." records on a pin of that block.
    Records DcmPinRecords(const std::string& pin) const;
};

// The pendra program of this build.
std::string PendraProgram();
// Runs `pendra generate ARGS --module MODULE` into a scratch folder and reads
// back MODULE.tsw.
GenerateRun Generate(const std::string& args, const std::string& module = "clkgen");
