#include "tools/Program.h"

#include "foundation/DateText.h"

#include <CLI/CLI.hpp>
#include <clocale>
#include <csignal>
#include <exception>
#include <iostream>

Program::Option& Program::Option::required()
{
    option_->required();
    return *this;
}

Program::Option& Program::Option::type(const std::string& name)
{
    option_->type_name(name);
    return *this;
}

Program::Option& Program::Option::group(const std::string& name)
{
    option_->group(name);
    return *this;
}

Program::Option& Program::Option::showDefault()
{
    option_->capture_default_str();
    return *this;
}

Program::Option& Program::Option::needs(const Option& other)
{
    option_->needs(other.option_);
    return *this;
}

Program::Option& Program::Option::excludes(const Option& other)
{
    option_->excludes(other.option_);
    return *this;
}

Program::Option& Program::Option::oneOf(std::initializer_list<const char*> texts)
{
    option_->check(CLI::IsMember(std::vector<std::string>(texts.begin(), texts.end())));
    return *this;
}

Program::Option& Program::Option::between(unsigned least, unsigned most)
{
    option_->check(CLI::Range(least, most));
    return *this;
}

Program::Option& Program::Option::ipv4()
{
    option_->check(CLI::ValidIPV4);
    return *this;
}

Program::Option& Program::Option::check(const Check& reason)
{
    option_->check(reason);
    return *this;
}

Program::Option& Program::Option::oneEach()
{
    option_->allow_extra_args(false);
    return *this;
}

Program::Program(const char* purpose, const char* name) : app_(std::make_unique<CLI::App>(purpose, name)) {}

Program::~Program() = default;

void Program::setFooter(const char* text)
{
    app_->footer(text);
}

Program::Option Program::add(const std::string& name, std::string& text, const std::string& purpose)
{
    return Option(app_->add_option(name, text, purpose));
}

Program::Option Program::add(const std::string& name, std::vector<std::string>& texts, const std::string& purpose)
{
    return Option(app_->add_option(name, texts, purpose));
}

Program::Option Program::add(const std::string& name, unsigned& number, const std::string& purpose)
{
    return Option(app_->add_option(name, number, purpose));
}

Program::Option Program::addFlag(const std::string& name, bool& flag, const std::string& purpose)
{
    return Option(app_->add_flag(name, flag, purpose));
}

Program::Option Program::addText(const std::string& name, std::string& text, const std::string& type,
                                 const std::string& purpose)
{
    const auto reason = [](const std::string& given) { return given.empty() ? "must not be empty" : std::string(); };
    return add(name, text, purpose).type(type).check(reason);
}

void Program::addDate(const std::string& name, Date& date, const std::string& purpose)
{
    const auto reason = [](const std::string& text) {
        const bool isDate = text.find('/') != std::string::npos && parseDate(text);
        return isDate ? std::string() : "is not a date DD/MM/YYYY: " + text;
    };
    // Runs when the check has passed, so there is a date. Without the option `date` stays what the caller has put
    // there.
    const auto take = [&date](const std::string& text) { date = *parseDate(text); };
    Option(app_->add_option_function<std::string>(name, take, purpose)).type("DD/MM/YYYY").check(reason);
}

bool Program::isGiven(const std::string& name) const
{
    const CLI::Option* option = app_->get_option_no_throw(name);
    return option != nullptr && option->count() > 0;
}

int Program::run(int argc, char** argv, const std::function<void()>& run)
{
    constexpr int kFailure = 1;
    constexpr int kBadArguments = 2;
    // A reader that leaves early is to be a failed write like any other.
    std::signal(SIGPIPE, SIG_IGN);
    std::signal(SIGXFSZ, SIG_IGN); // so is a file that grows past the user's limit
    // Names are UTF-8 whatever the user's locale; without it they lose what is not ASCII in messages and tables.
    std::setlocale(LC_CTYPE, "C.UTF-8");
    app_->set_version_flag("--version", PELORIN_VERSION);
    try {
        // Nothing has been read or written so far: bad arguments leave no trace.
        app_->parse(argc, argv);
        run();
        return 0;
    } catch (const CLI::ParseError& error) {
        // The help and the version come as errors as well, of the code 0.
        return app_->exit(error) == 0 ? 0 : kBadArguments;
    } catch (const BadArguments& error) {
        app_->exit(CLI::ParseError(error.what(), kBadArguments));
        return kBadArguments;
    } catch (const std::exception& error) {
        std::cerr << app_->get_name() << ": " << error.what() << '\n';
        return kFailure;
    }
}
