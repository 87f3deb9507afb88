#pragma once
// The saved design (.tsw): JSON holding the wizard type, the part, the module
// name, the version of the tool that wrote it and the whole design database.
// Pendra writes every block whole ("complete"); a hand-written file may give
// only what differs from the part's template blocks.

#include "port/StringBase.h"

#include <string>

class Tsy_WizData;

struct Tsy_DesignHeader {
    StringBase wizard;
    StringBase part;
    StringBase module;
    StringBase version;
};

class Tsy_DesignFile {
public:
    static constexpr int kFormat = 1;

    static std::string ToText(const Tsy_DesignHeader& header, const Tsy_WizData& data);

    // The header of a design file. Throws Port::Exception with the file, the
    // place in it and the reason.
    static Tsy_DesignHeader ReadHeader(const std::string& path);
    // Loads the file's blocks and signals into the database (which holds the
    // part's templates). Blocks of an earlier generated netlist come back
    // inactive: the next Finish builds the netlist anew. Throws as above; the
    // database is untouched when the file is refused.
    static Tsy_DesignHeader Load(const std::string& path, Tsy_WizData& data);
    static Tsy_DesignHeader LoadText(const std::string& text, const std::string& origin, Tsy_WizData& data);
};
