#pragma once

#include "foundation/Date.h"

#include <CLI/CLI.hpp>
#include <functional>
#include <string>

/// What every tool's `main` does: reads the command line that `app` describes, and runs. What `run` throws is told on
/// standard error in one line.
/// @return the exit status: 0; 1 when `run` failed, 2 for bad arguments.
int runProgram(CLI::App& app, int argc, char** argv, const std::function<void()>& run);

/// Adds an option that sets `date`.
///
/// The dates of a command line are DD/MM/YYYY, the form that the program shows and takes everywhere else; not the ISO
/// form that tables may have.
void addDate(CLI::App& app, const std::string& name, Date& date, const std::string& purpose);

/// Adds an option whose text must not be empty; `type` is what the help calls it.
CLI::Option* addText(CLI::App& app, const std::string& name, std::string& text, const std::string& type,
                     const std::string& purpose);
