#pragma once

#include "tools/Program.h"

#include <memory>
#include <string>

/// What several ways of importing are told by options of one name.
struct ImportArguments {
    std::string output;    // OUTPUT: the market file to make
    std::string into;      // --into: the market file to import into
    std::string portfolio; // --portfolio: the portfolio file to import into
    bool dryRun = false;   // --dry-run: only tell what would come of it
    std::string market;    // --market: a name or, where operations are imported, a file
    bool force = false;
};

/// One of the ways in which pelorin-import works. It adds its own options to the program's, and is meant when its
/// telling one is given.
class ImportMode {
public:
    virtual ~ImportMode() = default;

    virtual void describe(Program& program) = 0;
    virtual bool isMeant(const Program& program) const = 0;
    /// Throws BadArguments for options that do not go together, std::runtime_error for what cannot be done.
    virtual void run(const Program& program, const ImportArguments& arguments) = 0;
};

/// Market data from tables of quotes and rates: what is meant when no other way is.
std::unique_ptr<ImportMode> importTables();
/// Operations from a statement into a portfolio file: what is meant with --operations.
std::unique_ptr<ImportMode> importOperations();
/// What pelorin-export has written as tables, back into files: what is meant with --from.
std::unique_ptr<ImportMode> importFolder();
