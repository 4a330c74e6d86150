#include "storage/DataFolder.h"

#include "storage/Folders.h"
#include "storage/InputFile.h"

#include <cstdlib>
#include <pwd.h>
#include <sstream>
#include <stdexcept>
#include <string_view>
#include <unistd.h>

namespace {

constexpr const char* kBlanks = " \t\r\v\f";

std::string homeFolder()
{
    const char* home = std::getenv("HOME");
    if (home != nullptr && *home != '\0')
        return home;
    const passwd* user = getpwuid(getuid());
    return user != nullptr ? user->pw_dir : "";
}

std::string configurationFolder(const std::string& home)
{
    const char* named = std::getenv("XDG_CONFIG_HOME");
    return named != nullptr && *named == '/' ? named : home + "/.config";
}

std::string_view withoutBlanksInFront(std::string_view text)
{
    const std::size_t first = text.find_first_not_of(kBlanks);
    return first == std::string_view::npos ? std::string_view() : text.substr(first);
}

/// Takes `what`, and the blanks around it, off the front of `*text`. @return false when it is not there.
bool take(std::string_view what, std::string_view* text)
{
    *text = withoutBlanksInFront(*text);
    if (!text->starts_with(what))
        return false;
    *text = withoutBlanksInFront(text->substr(what.size()));
    return true;
}

/// What `line` says the documents folder is, with its backslashes resolved. @return false when it does not say.
bool readDocumentsLine(std::string_view line, std::string* value)
{
    if (!take("XDG_DOCUMENTS_DIR", &line) || !take("=", &line) || !line.starts_with('"'))
        return false;
    const std::size_t end = line.rfind('"');
    if (end == 0)
        return false;
    line = line.substr(1, end - 1);
    value->clear();
    // The file is made for a shell, in which a backslash makes the next character an ordinary one.
    for (std::size_t i = 0; i < line.size(); ++i) {
        if (line[i] == '\\' && i + 1 < line.size())
            ++i;
        *value += line[i];
    }
    return true;
}

/// What the file holds; nothing when it cannot be opened.
std::string contentOf(const std::string& path)
{
    std::string content;
    try {
        const InputFile file(path);
        char piece[4096];
        while (const std::size_t got = std::fread(piece, 1, sizeof piece, file.stream()))
            content.append(piece, got);
    } catch (const std::runtime_error&) {
        // As a rule it is not there: the desktop does without it.
    }
    return content;
}

/// The folder that the desktop's configuration names; empty when it names none. The last line counts.
std::string configuredDocuments(const std::string& home)
{
    std::istringstream file(contentOf(configurationFolder(home) + "/user-dirs.dirs"));
    std::string value;
    for (std::string line; std::getline(file, line);)
        readDocumentsLine(line, &value);
    // The only variable that may stand there; any other relative path is none.
    constexpr std::string_view kHome = "$HOME";
    if (value == kHome || value.starts_with(std::string(kHome) + '/'))
        return home + value.substr(kHome.size());
    return value.starts_with('/') ? value : std::string();
}

std::string documentsFolder(const std::string& home)
{
    std::string folder = configuredDocuments(home);
    if (folder.empty())
        folder = home + "/Documents";
    if (folder.ends_with('/'))
        folder.pop_back();
    return folder;
}

} // namespace

DataFolder::DataFolder()
{
    const std::string home = homeFolder();
    if (!home.empty())
        path_ = documentsFolder(home) + "/Pelorin";
}

std::string DataFolder::need(const char* subfolder, unsigned mode, std::string* error) const
{
    const std::string path = path_ + subfolder;
    error->clear();
    // "/Companies" of the whole machine would be meant otherwise.
    if (path_.empty()) {
        *error = "There is no home folder to keep files in.";
        return path;
    }
    // The data folder by itself first: it is open to whom the user's mask allows, even when `mode` is for the user
    // alone.
    std::error_code reason = makeFolders(path_);
    if (!reason)
        reason = makeFolders(path, mode);
    if (reason)
        *error = path + ": cannot be made: " + reason.message();
    return path;
}
