#include "tools/Program.h"

#include "foundation/DateText.h"
#include "foundation/Today.h"

#include <clocale>
#include <csignal>
#include <exception>
#include <iostream>

int runProgram(CLI::App& app, int argc, char** argv, const std::function<void()>& run)
{
    constexpr int kFailure = 1;
    constexpr int kBadArguments = 2;
    // A reader that leaves early is to be a failed write like any other.
    std::signal(SIGPIPE, SIG_IGN);
    // Names are UTF-8 whatever the user's locale; without it they lose what is not ASCII in messages and tables.
    std::setlocale(LC_CTYPE, "C.UTF-8");
    app.set_version_flag("--version", PELORIN_VERSION);
    try {
        // Nothing has been read or written so far: bad arguments leave no trace.
        app.parse(argc, argv);
        run();
        return 0;
    } catch (const CLI::ParseError& error) {
        return app.exit(error) == 0 ? 0 : kBadArguments;
    } catch (const std::exception& error) {
        std::cerr << app.get_name() << ": " << error.what() << '\n';
        return kFailure;
    }
}

std::string checkDateArgument(const std::string& text)
{
    const bool isDate = text.find('/') != std::string::npos && parseDate(text);
    return isDate ? std::string() : "is not a date DD/MM/YYYY: " + text;
}

Date dateArgument(const std::string& text)
{
    return text.empty() ? today() : *parseDate(text);
}

std::string checkNotEmpty(const std::string& text)
{
    return text.empty() ? "must not be empty" : std::string();
}
