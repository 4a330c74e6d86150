#include "tools/Program.h"

#include "foundation/DateText.h"

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
    std::signal(SIGXFSZ, SIG_IGN); // so is a file that grows past the user's limit
    // Names are UTF-8 whatever the user's locale; without it they lose what is not ASCII in messages and tables.
    std::setlocale(LC_CTYPE, "C.UTF-8");
    app.set_version_flag("--version", PELORIN_VERSION);
    try {
        // Nothing has been read or written so far: bad arguments leave no trace.
        app.parse(argc, argv);
        run();
        return 0;
    } catch (const CLI::ParseError& error) {
        // The help and the version come as errors as well, of the code 0.
        return app.exit(error) == 0 ? 0 : kBadArguments;
    } catch (const std::exception& error) {
        std::cerr << app.get_name() << ": " << error.what() << '\n';
        return kFailure;
    }
}

void addDate(CLI::App& app, const std::string& name, Date& date, const std::string& purpose)
{
    const auto check = [](const std::string& text) {
        const bool isDate = text.find('/') != std::string::npos && parseDate(text);
        return isDate ? std::string() : "is not a date DD/MM/YYYY: " + text;
    };
    // Runs when the check has passed, so there is a date. Without the option `date` stays what the caller has put
    // there.
    const auto take = [&date](const std::string& text) { date = *parseDate(text); };
    app.add_option_function<std::string>(name, take, purpose)->type_name("DD/MM/YYYY")->check(check);
}

CLI::Option* addText(CLI::App& app, const std::string& name, std::string& text, const std::string& type,
                     const std::string& purpose)
{
    const auto check = [](const std::string& given) { return given.empty() ? "must not be empty" : std::string(); };
    return app.add_option(name, text, purpose)->type_name(type)->check(check);
}
