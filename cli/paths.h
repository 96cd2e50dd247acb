// Where the program's plug-in and bundled schemas lie, relative to the program itself.
#pragma once

#include <string>

std::string defaultPluginPath();
std::string defaultSchemaPath();
