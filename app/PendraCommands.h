#pragma once
// The commands of the pendra program. Each returns the process exit code:
// 0 success, 1 the wizard refused the design (nothing written), 2 a usage
// error or an unreadable input.

#include "run/Tsy_HostSession.h"

#include <string>

int PendraListWizards();
int PendraListParts(const std::string& filter);
int PendraGenerate(const Tsy_RunOptions& options);
int PendraGui(Tsy_RunOptions options, int argc, char** argv);
