#pragma once

#include <CLI/CLI.hpp>
#include <functional>
#include <string>

/// What every tool's `main` does: reads the command line that `app` describes, and runs. What `run` throws is told on
/// standard error in one line.
/// @return the exit status: 0; 1 when `run` failed, 2 for bad arguments.
int runProgram(CLI::App& app, int argc, char** argv, const std::function<void()>& run);

/// What is wrong with an argument that must have a text; empty when nothing is.
std::string checkNotEmpty(const std::string& text);
