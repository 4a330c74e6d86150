#include "app/Guide.h"

#include "app/PLWindow.h"
#include "platform/Message.h"
#include "platform/Roster.h"

#include <sys/auxv.h>

#include <filesystem>

namespace {

/// The same from where the program is built as from where it is installed.
std::filesystem::path folder()
{
    // By what the program was started as: /proc, which knows it, too, is not there in every closed-off system.
    const auto* name = reinterpret_cast<const char*>(::getauxval(AT_EXECFN));
    std::error_code error; // it is nowhere: then the path leads nowhere, either
    const auto program = std::filesystem::canonical(name != nullptr ? name : "", error);
    return (program.parent_path() / "../share/help/C/pelorin").lexically_normal();
}

} // namespace

void Guide::addKey(BWindow& inWindow, const char* page)
{
    auto* message = new BMessage(kOpen);
    if (page != nullptr)
        message->AddString("page", page);
    inWindow.AddShortcut(B_F1_KEY, 0, message, &window_);
}

void Guide::open(const std::string& page)
{
    window_.dropNotice("guide"); // the next one is about this time
    const entry_ref file{folder().string(), page + ".html"};
    const std::string path = folder() / file.name;
    std::error_code error;
    if (!std::filesystem::exists(path, error))
        return tell("The guide is not there: it should be " + path);
    auto* failed = new BMessage(kFailed);
    failed->AddString("path", path.c_str());
    const BMessenger window(&window_);
    be_roster->Launch(&file, window, failed);
}

void Guide::tellFailure(const BMessage* message)
{
    const char* path = "";
    if (message->FindString("path", &path) == B_OK)
        tell(std::string("No browser has opened the guide, which is ") + path);
}

void Guide::tell(const std::string& text)
{
    Notice notice{"guide", text, {}};
    notice.isAnswer = true;
    window_.showNotice(std::move(notice));
}
