// pendra: configures the clock blocks of an FPGA design through the clock
// wizard plug-in, in a window (gui) or silently (generate).

#include "PendraCommands.h"

#include <CLI/CLI.hpp>

#include <iostream>

namespace {

void addDesignOptions(CLI::App* cmd, Tsy_RunOptions& o)
{
    cmd->add_option("--wizard", o.wizard, "Wizard type (see 'pendra wizards')");
    cmd->add_option("--part", o.part, "Target part (see 'pendra parts')");
    cmd->add_option("--module", o.module, "Name of the generated module");
    cmd->add_option("-o,--output-dir", o.outDir, "Folder for the written files")->capture_default_str();
}

} // namespace

int main(int argc, char** argv)
{
    CLI::App app{"pendra - clock wizard for Corvane FPGA designs", "pendra"};
    app.set_version_flag("--version", std::string("pendra ") + PENDRA_VERSION);
    app.require_subcommand(1);

    Tsy_RunOptions gen;
    CLI::App* generate = app.add_subcommand("generate", "Run a wizard silently and write the design files");
    generate->add_option("design", gen.designFile, "Saved design (.tsw) to start from")->check(CLI::ExistingFile);
    addDesignOptions(generate, gen);
    generate->add_option("--set", gen.sets, "TARGET.ATTR=VALUE or TARGET.PIN.ATTR=VALUE (repeatable)");
    generate->add_option("--pin", gen.pins, "TARGET.PIN=on|off (repeatable)");

    Tsy_RunOptions gui;
    CLI::App* guiCmd = app.add_subcommand("gui", "Open the wizard window");
    guiCmd->add_option("design", gui.designFile, "Saved design (.tsw) to open")->check(CLI::ExistingFile);
    addDesignOptions(guiCmd, gui);

    std::string filter;
    CLI::App* parts = app.add_subcommand("parts", "List the parts of the device catalogue");
    parts->add_option("filter", filter, "Show only parts whose name, family, device or speed grade holds this");

    CLI::App* wizards = app.add_subcommand("wizards", "List the wizard types");

    // CLI11 would only say a subcommand is missing; name the word instead.
    const std::string first = argc > 1 ? argv[1] : "";
    if (!first.empty() && first[0] != '-' && first != "generate" && first != "gui" && first != "parts"
        && first != "wizards") {
        std::cerr << "pendra: unknown command '" << argv[1] << "' (see 'pendra --help')" << std::endl;
        return Tsy_HostSession::kUsage;
    }
    try {
        app.parse(argc, argv);
    } catch (const CLI::CallForHelp& e) {
        return app.exit(e);
    } catch (const CLI::CallForAllHelp& e) {
        return app.exit(e);
    } catch (const CLI::CallForVersion& e) {
        return app.exit(e);
    } catch (const CLI::ParseError& e) {
        std::cerr << "pendra: " << e.what() << " (see 'pendra --help')" << std::endl;
        return Tsy_HostSession::kUsage;
    }

    if (*generate)
        return PendraGenerate(gen);
    if (*guiCmd)
        return PendraGui(gui, argc, argv);
    if (*parts)
        return PendraListParts(filter);
    if (*wizards)
        return PendraListWizards();
    return Tsy_HostSession::kUsage;
}
