#include "exchange/UniqueNames.h"

#include "exchange/TableText.h"

#include <algorithm>

std::string cleanName(std::string_view bytes)
{
    std::string name;
    while (!bytes.empty()) {
        const std::size_t length = characterLength(bytes);
        const bool isText = length > 0 && static_cast<unsigned char>(bytes.front()) > ' ' && bytes.front() != '\x7F';
        if (isText)
            name += bytes.substr(0, length);
        else if (!name.empty() && name.back() != ' ')
            name += ' ';
        bytes.remove_prefix(std::max<std::size_t>(length, 1));
    }
    if (name.ends_with(' '))
        name.pop_back();
    return name.empty() ? "unnamed" : name;
}
