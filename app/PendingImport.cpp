#include "app/PendingImport.h"

#include "foundation/NumberText.h"
#include "platform/ShortText.h"

std::string importedName(const std::string& path)
{
    constexpr std::size_t kLongest = 60; // bytes
    return shortened(path.substr(path.rfind('/') + 1), kLongest);
}

std::string importedCount(std::size_t n, const char* what)
{
    return countText(static_cast<int>(n)) + ' ' + what + (n == 1 ? "" : "s");
}
