#pragma once

#include "foundation/Date.h"

#include <functional>
#include <initializer_list>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

namespace CLI {
class App;
class Option;
} // namespace CLI

/// What ends a program with the status of bad arguments; its text is one line for the user.
struct BadArguments : std::runtime_error {
    using std::runtime_error::runtime_error;

    static BadArguments missing(const std::string& what) { return BadArguments(what + " is required"); }
    static BadArguments apart(const std::string& one, const std::string& other)
    {
        return BadArguments(one + " excludes " + other);
    }
};

/// The options and arguments of a program, described by its `main` and its parts. The parser's own header, which takes
/// long to compile, is known to Program.cpp alone.
class Program {
public:
    /// One option, or an argument when its name has no "--", of which more can be said.
    class Option {
    public:
        using Check = std::function<std::string(const std::string& given)>;

        explicit Option(CLI::Option* option) : option_(option) {} // the program's

        Option& required();
        /// What the help calls it.
        Option& type(const std::string& name);
        /// The headline under which the help has it.
        Option& group(const std::string& name);
        /// The help tells what it is without.
        Option& showDefault();
        Option& needs(const Option& other);
        Option& excludes(const Option& other);
        Option& oneOf(std::initializer_list<const char*> texts);
        Option& between(unsigned least, unsigned most);
        Option& ipv4();
        /// `reason` says what is wrong with a given text, nothing when it is good.
        Option& check(const Check& reason);
        /// Of a list: each text comes behind a name of its own.
        Option& oneEach();

    private:
        CLI::Option* option_;
    };

    Program(const char* purpose, const char* name);
    ~Program();

    /// Behind the options in the help.
    void setFooter(const char* text);
    Option add(const std::string& name, std::string& text, const std::string& purpose);
    Option add(const std::string& name, std::vector<std::string>& texts, const std::string& purpose);
    Option add(const std::string& name, unsigned& number, const std::string& purpose);
    Option addFlag(const std::string& name, bool& flag, const std::string& purpose);
    /// One whose text must not be empty.
    Option addText(const std::string& name, std::string& text, const std::string& type, const std::string& purpose);
    /// One that sets `date`.
    ///
    /// The dates of a command line are DD/MM/YYYY, the form that the program shows and takes everywhere else; not the
    /// ISO form that tables may have.
    void addDate(const std::string& name, Date& date, const std::string& purpose);
    /// Whether the user has given it; false, too, for what this program does not have.
    bool isGiven(const std::string& name) const;

    /// What every `main` does: reads the command line, and runs. What `run` throws is told on standard error.
    /// @return the exit status: 0; 1 when `run` failed, 2 for bad arguments.
    int run(int argc, char** argv, const std::function<void()>& run);

private:
    std::unique_ptr<CLI::App> app_;
};
