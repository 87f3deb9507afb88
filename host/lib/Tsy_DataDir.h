#pragma once

#include <nlohmann/json.hpp>

#include <string>

// Where the device catalogue, primitive library, speed files and help pages
// live: $PENDRA_DATA_DIR, else share/pendra beside the installed program,
// else the source tree's data/ directory.
std::string Tsy_DataDir();
// The folder of the running program, empty when it cannot be told.
std::string Tsy_ExecutableDir();
bool Tsy_IsDirectory(const std::string& path);
std::string Tsy_DataFile(const std::string& relative);

// Reads a JSON document. A missing or malformed file throws Port::Exception
// with one line naming the file, the place in it and the reason.
nlohmann::ordered_json Tsy_ReadJsonFile(const std::string& path);
// The same for text already read; 'origin' names it in messages.
nlohmann::ordered_json Tsy_ParseJson(const std::string& text, const std::string& origin);
