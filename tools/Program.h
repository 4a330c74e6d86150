#pragma once

#include "foundation/Date.h"

#include <CLI/CLI.hpp>
#include <functional>
#include <string>

/// What every tool's `main` does: reads the command line that `app` describes, and runs. What `run` throws is told on
/// standard error in one line.
/// @return the exit status: 0; 1 when `run` failed, 2 for bad arguments.
int runProgram(CLI::App& app, int argc, char** argv, const std::function<void()>& run);

/// The dates of a command line are DD/MM/YYYY, the form that the program shows and takes everywhere else; not the ISO
/// form that tables may have.
/// @return what is wrong with `text`; empty when it is a date.
std::string checkDateArgument(const std::string& text);
/// The date of a text that `checkDateArgument` has passed; today, local time, for an empty one.
Date dateArgument(const std::string& text);

/// What is wrong with an argument that must have a text; empty when nothing is.
std::string checkNotEmpty(const std::string& text);
