#ifndef REISTI_CLI_COMMANDS_H
#define REISTI_CLI_COMMANDS_H

#include <CLI/App.hpp>

namespace cli {

// Each adds its subcommand; parsing the command line then runs it.

void addDsdCommand(CLI::App& app);
void addCentroidCommand(CLI::App& app);
void addLatticeCommand(CLI::App& app);
void addVerticesCommand(CLI::App& app);
void addCatalogCommand(CLI::App& app);

}  // namespace cli

#endif
