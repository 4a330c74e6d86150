#include "platform/Handler.h"

#include <unordered_map>

namespace {

/// Every handler, from its construction to its destruction, by token.
std::unordered_map<std::uint64_t, BHandler*>& living()
{
    static std::unordered_map<std::uint64_t, BHandler*> handlers;
    return handlers;
}

std::uint64_t nextToken()
{
    // 0 stays nobody's: a messenger without target has it.
    static std::uint64_t last = 0;
    return ++last;
}

} // namespace

BHandler::BHandler(const char* name) : name_(name != nullptr ? name : ""), token_(nextToken())
{
    living()[token_] = this;
}

BHandler::~BHandler()
{
    living().erase(token_);
}

BHandler* BHandler::withToken(std::uint64_t token)
{
    const auto found = living().find(token);
    return found != living().end() ? found->second : nullptr;
}
