#include "exchange/UniqueNames.h"

#include "exchange/TextForms.h"

std::string cleanName(std::string_view bytes)
{
    std::string name;
    while (!bytes.empty()) {
        const std::string_view rest = bytes;
        const char32_t c = takeCharacter(bytes);
        if (c > ' ' && c != '\x7F' && c != kBrokenCharacter)
            name += rest.substr(0, rest.size() - bytes.size());
        else if (!name.empty() && name.back() != ' ')
            name += ' ';
    }
    if (name.ends_with(' '))
        name.pop_back();
    return name.empty() ? "unnamed" : name;
}
