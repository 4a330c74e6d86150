#include "storage/RescueNote.h"

#include "storage/Checksum.h"
#include "storage/InputFile.h"

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <sstream>
#include <stdexcept>
#include <vector>

namespace {

constexpr const char* kHead = "Pelorin unsaved 1";

std::string sumLine(const std::string& text)
{
    char line[32];
    std::snprintf(line, sizeof line, "sum %016llx\n", static_cast<unsigned long long>(checksumOf(text)));
    return line;
}

} // namespace

std::string RescueNote::text() const
{
    std::ostringstream out;
    out << kHead << '\n' << time << '\n';
    for (const Part& part : parts) // a path may have any bytes, so its length stands before it
        out << part.generation << ' ' << part.copy.size << ' ' << std::hex << part.copy.sum << std::dec << ' '
            << part.isAsked << ' ' << part.path.size() << ' ' << part.path << '\n';
    return out.str() + sumLine(out.str());
}

std::optional<RescueNote> RescueNote::read(const std::string& text)
{
    const std::size_t end = text.rfind("sum ");
    if (end == std::string::npos || text.substr(end) != sumLine(text.substr(0, end)))
        return std::nullopt;
    std::istringstream in(text.substr(0, end));
    std::string head;
    RescueNote note;
    std::getline(in, head);
    in >> note.time;
    for (Part& part : note.parts) {
        std::size_t length = 0;
        in >> part.generation >> part.copy.size >> std::hex >> part.copy.sum >> std::dec >> part.isAsked >> length;
        in.get(); // the blank before the path
        if (!in || length > end)
            return std::nullopt;
        part.path.resize(length);
        in.read(part.path.data(), static_cast<std::streamsize>(length));
    }
    return in && head == kHead ? std::optional(note) : std::nullopt;
}

RescueNote::Fingerprint fingerprintOf(const std::string& path)
{
    const InputFile file(path);
    RescueNote::Fingerprint fingerprint{0, kChecksumOfNothing};
    std::vector<char> block(1 << 16);
    while (const std::size_t size = std::fread(block.data(), 1, block.size(), file.stream())) {
        fingerprint.size += size;
        fingerprint.sum = checksumOf({block.data(), size}, fingerprint.sum);
    }
    if (std::ferror(file.stream()) != 0)
        throw std::runtime_error(path + ": cannot be read: " + std::strerror(errno));
    return fingerprint;
}
