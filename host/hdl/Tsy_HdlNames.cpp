#include "hdl/Tsy_HdlNames.h"

#include <algorithm>
#include <cctype>
#include <set>

namespace {

const std::set<std::string>& verilogKeywords()
{
    static const std::set<std::string> words = {
        "always", "and", "assign", "automatic", "begin", "buf", "bufif0", "bufif1", "case", "casex", "casez", "cell",
        "cmos", "config", "deassign", "default", "defparam", "design", "disable", "edge", "else", "end", "endcase",
        "endconfig", "endfunction", "endgenerate", "endmodule", "endprimitive", "endspecify", "endtable", "endtask",
        "event", "for", "force", "forever", "fork", "function", "generate", "genvar", "highz0", "highz1", "if",
        "ifnone", "incdir", "include", "initial", "inout", "input", "instance", "integer", "join", "large",
        "liblist", "library", "localparam", "macromodule", "medium", "module", "nand", "negedge", "nmos", "nor",
        "noshowcancelled", "not", "notif0", "notif1", "or", "output", "parameter", "pmos", "posedge", "primitive",
        "pull0", "pull1", "pulldown", "pullup", "pulsestyle_ondetect", "pulsestyle_onevent", "rcmos", "real",
        "realtime", "reg", "release", "repeat", "rnmos", "rpmos", "rtran", "rtranif0", "rtranif1", "scalared",
        "showcancelled", "signed", "small", "specify", "specparam", "strong0", "strong1", "supply0", "supply1",
        "table", "task", "time", "tran", "tranif0", "tranif1", "tri", "tri0", "tri1", "triand", "trior", "trireg",
        "unsigned", "use", "uwire", "vectored", "wait", "wand", "weak0", "weak1", "while", "wire", "wor", "xnor",
        "xor",
        // SystemVerilog words that lint tools reject as names as well.
        "bit", "byte", "int", "logic", "shortint", "longint", "string", "type", "interface", "class", "package",
        "program", "property", "sequence", "final", "import", "export", "return", "break", "continue", "do",
        "enum", "struct", "union", "typedef", "void", "const", "static", "virtual", "extends", "new", "null",
        "this", "super", "priority", "unique", "assert", "assume", "cover", "bind", "chandle", "clocking",
        "constraint", "context", "covergroup", "coverpoint", "cross", "dist", "expect", "extern", "first_match",
        "forkjoin", "iff", "ignore_bins", "illegal_bins", "inside", "intersect", "join_any", "join_none", "local",
        "matches", "modport", "packed", "protected", "pure", "rand", "randc", "randcase", "randsequence", "ref",
        "solve", "tagged", "throughout", "timeprecision", "timeunit", "var", "wait_order", "wildcard", "with",
        "within", "alias", "always_comb", "always_ff", "always_latch", "endclass", "endclocking", "endgroup",
        "endinterface", "endpackage", "endprogram", "endproperty", "endsequence", "foreach", "shortreal"};
    return words;
}

const std::set<std::string>& vhdlKeywords()
{
    static const std::set<std::string> words = {
        "abs", "access", "after", "alias", "all", "and", "architecture", "array", "assert", "attribute", "begin",
        "block", "body", "buffer", "bus", "case", "component", "configuration", "constant", "disconnect",
        "downto", "else", "elsif", "end", "entity", "exit", "file", "for", "function", "generate", "generic",
        "group", "guarded", "if", "impure", "in", "inertial", "inout", "is", "label", "library", "linkage",
        "literal", "loop", "map", "mod", "nand", "new", "next", "nor", "not", "null", "of", "on", "open", "or",
        "others", "out", "package", "port", "postponed", "procedure", "process", "pure", "range", "record",
        "register", "reject", "rem", "report", "return", "rol", "ror", "select", "severity", "shared", "signal",
        "sla", "sll", "sra", "srl", "subtype", "then", "to", "transport", "type", "unaffected", "units", "until",
        "use", "variable", "wait", "when", "while", "with", "xnor", "xor",
        // VHDL-2008 additions, so the output stays portable.
        "assume", "context", "cover", "default", "fairness", "force", "parameter", "property", "protected",
        "release", "restrict", "sequence", "strong", "vmode", "vprop", "vunit"};
    return words;
}

} // namespace

std::string Tsy_HdlFoldCase(const std::string& name)
{
    std::string out = name;
    std::transform(out.begin(), out.end(), out.begin(), [](unsigned char c) { return std::tolower(c); });
    return out;
}

std::string Tsy_HdlNameProblem(const std::string& name)
{
    if (name.empty())
        return "is empty";
    if (!std::isalpha(static_cast<unsigned char>(name[0])))
        return "must begin with a letter";
    for (char c : name)
        if (!std::isalnum(static_cast<unsigned char>(c)) && c != '_')
            return "may hold only letters, digits and '_'";
    if (name.back() == '_')
        return "must not end with '_' (VHDL)";
    if (name.find("__") != std::string::npos)
        return "must not hold two '_' in a row (VHDL)";
    if (name.size() > 200)
        return "is longer than 200 characters";
    std::string l = Tsy_HdlFoldCase(name);
    if (verilogKeywords().count(name) || verilogKeywords().count(l))
        return "is a Verilog keyword";
    if (vhdlKeywords().count(l))
        return "is a VHDL keyword";
    return std::string();
}
