#include <CLI/App.hpp>
#include <CLI/Config.hpp>
#include <CLI/Formatter.hpp>
#include <algorithm>
#include <exception>
#include <iostream>
#include <new>
#include <string>
#include <vector>

#include "commands.h"
#include "reisti/reisti.h"
#include "usage_error.h"

namespace {

/// One line for a complaint of the argument parser.
int reportParseError(const CLI::App& app, const CLI::ParseError& error) {
    if (error.get_exit_code() == 0) return app.exit(error);
    std::string message = error.what();
    // The parser misses a command before it looks at the word that stands in its place.
    const std::vector<std::string> unknown = app.remaining();
    if (app.get_subcommands().empty() && !unknown.empty()) message = "no such command or option: " + unknown.front();
    std::replace(message.begin(), message.end(), '\n', ' ');
    std::cerr << "reisti: " << message << " (see --help)\n";
    return cli::kExitBadUsage;
}

int run(int argc, char** argv) {
    CLI::App app("Experimental designs: definitive screening designs and mixture designs", "reisti");
    app.require_subcommand(1);
    app.set_version_flag("--version", std::string("reisti ") + des_Version());
    app.footer("reisti COMMAND --help shows the options of a command and a worked example.");
    cli::addDsdCommand(app);
    cli::addCentroidCommand(app);
    cli::addLatticeCommand(app);
    cli::addVerticesCommand(app);
    cli::addCatalogCommand(app);
    try {
        app.parse(argc, argv);
    } catch (const CLI::ParseError& error) {
        return reportParseError(app, error);
    } catch (const cli::UsageError& error) {
        std::cerr << "reisti: " << error.what() << '\n';
        return cli::kExitBadUsage;
    } catch (const cli::RunError& error) {
        std::cerr << "reisti: " << error.what() << '\n';
        return cli::kExitFailedRun;
    }
    return cli::kExitSuccess;
}

}  // namespace

int main(int argc, char** argv) {
    try {
        return run(argc, argv);
    } catch (const std::bad_alloc&) {
        std::cerr << "reisti: out of memory\n";
    } catch (const std::exception& error) {
        std::cerr << "reisti: " << error.what() << '\n';
    }
    return cli::kExitFailedRun;
}
