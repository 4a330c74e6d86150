#include "platform/Handler.h"

#include <unordered_map>

namespace {

std::unordered_map<std::uint64_t, BHandler*>& living()
{
    static std::unordered_map<std::uint64_t, BHandler*> handlers;
    return handlers;
}

std::uint64_t nextToken()
{
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

void BHandler::MessageReceived(BMessage*) {}

BHandler* BHandler::withToken(std::uint64_t token)
{
    const auto found = living().find(token);
    return found != living().end() ? found->second : nullptr;
}
