#include "exchange/ProfileFolder.h"

#include "exchange/CsvReader.h"
#include "exchange/StatementTable.h"
#include "exchange/TextForms.h"
#include "storage/AtomicFile.h"
#include "storage/InputFile.h"

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <filesystem>
#include <set>
#include <stdexcept>

namespace {

constexpr const char* kMark = "# for headings ";

/// A number made of headings, by the formula of Fowler, Noll and Vo (FNV-1a) over the bytes of their keys.
std::string numberOf(const std::vector<std::string>& headings)
{
    constexpr std::uint64_t kOffset = 0xcbf29ce484222325;
    constexpr std::uint64_t kPrime = 0x100000001b3;
    std::uint64_t hash = kOffset;
    const auto take = [&](char byte) { hash = (hash ^ static_cast<unsigned char>(byte)) * kPrime; };
    for (const std::string& heading : headings) {
        std::ranges::for_each(wordKey(isUtf8(heading) ? heading : fromWindows1252(heading)), take);
        take('\n');
    }
    constexpr std::size_t kDigits = 16;
    char text[kDigits + 1];
    std::snprintf(text, sizeof text, "%016llx", static_cast<unsigned long long>(hash));
    return text;
}

/// The number in the file's first line; empty in a file that has none, or cannot be read.
std::string numberIn(const std::string& path)
{
    try {
        const InputFile file(path);
        char line[64];
        const std::string_view mark = kMark;
        if (std::fgets(line, sizeof line, file.stream()) == nullptr || !std::string_view(line).starts_with(mark))
            return {};
        const std::string text = line + mark.size();
        return text.substr(0, text.find_first_of(" \r\n"));
    } catch (const std::runtime_error&) {
        return {};
    }
}

/// The files of the folder, by name.
std::vector<std::filesystem::path> filesIn(const std::string& folder)
{
    std::error_code error;
    std::vector<std::filesystem::path> files;
    for (std::filesystem::directory_iterator entry(folder, error), end; !error && entry != end; entry.increment(error))
        if (entry->is_regular_file(error))
            files.push_back(entry->path());
    std::ranges::sort(files);
    return files;
}

} // namespace

std::optional<ProfileFolder::Kept> ProfileFolder::find(const std::string& table) const
{
    const auto files = filesIn(path_);
    std::set<std::string> numbers; // of all lines that may be headings
    for (const char separator : StatementTable::kSeparators) {
        CsvReader reader(table, separator);
        for (std::size_t i = 0; i < StatementTable::kLongestPreamble && !files.empty() && reader.next(); ++i)
            numbers.insert(numberOf(reader.fields()));
    }
    for (const auto& file : files)
        if (numbers.contains(numberIn(file)))
            try {
                return Kept{file.filename(), StatementProfile::fromFile(file)};
            } catch (const std::runtime_error&) {
                // Whoever has edited it meant something else; the statement is read as if there were none.
            }
    return std::nullopt;
}

void ProfileFolder::keep(const std::string& name, const std::vector<std::string>& headings,
                         const StatementProfile& profile) const
{
    const std::string number = numberOf(headings);
    const auto files = filesIn(path_);
    const auto kept = std::ranges::find(files, number, [](const auto& file) { return numberIn(file); });
    std::string path = path_ + '/' + name;
    for (int i = 2; kept == files.end() && std::filesystem::exists(path); ++i)
        path = path_ + '/' + name + ' ' + std::to_string(i);
    AtomicFile file(kept != files.end() ? kept->string() : path, AtomicFile::Existing::kReplace);
    if (std::fputs((kMark + number + '\n' + profile.toText()).c_str(), file.stream()) < 0)
        file.fail("cannot be written");
    file.commit();
}
