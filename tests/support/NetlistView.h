#pragma once
// Reading the netlist Finish left in a design database the way a designer
// reads a schematic: which blocks are in it, what each pin connects to, which
// nets are ports.

#include "db/Tsy_WizData.h"

#include <string>
#include <vector>

class NetlistView {
public:
    explicit NetlistView(const Tsy_WizData& data) : data_(data) {}

    // The active block of that name, or null.
    const Tsy_Block* Block(const std::string& name) const;
    // The type of the active block, "" when there is none.
    std::string TypeOf(const std::string& block) const;
    // What an active pin connects to: its net, "GND" or "VCC"; "" for an
    // unconnected pin, "(inactive)" for a pin not in use, "(none)" when the
    // block or pin does not exist.
    std::string On(const std::string& block, const std::string& pin) const;
    // "in" or "out" for an active port, "net" for an active internal net,
    // "" otherwise.
    std::string Kind(const std::string& signal) const;
    std::string Attr(const std::string& signal, const std::string& attr) const;
    int Width(const std::string& signal) const;
    // "NAME:TYPE" of every active block, sorted.
    std::vector<std::string> Blocks() const;
    // "NAME:in" / "NAME:out" of every active port, sorted.
    std::vector<std::string> Ports() const;
    // The active blocks of a type.
    int Count(const std::string& type) const;

private:
    const Tsy_WizData& data_;
};
