#pragma once

#include <filesystem>
#include <unistd.h>

/// As long as this object is there, the tests are not the superuser, whom no permission stops; `folder` is handed to
/// the user they are instead.
class PlainUser {
public:
    explicit PlainUser(const std::filesystem::path& folder)
    {
        if (geteuid() == 0 && chown(folder.c_str(), kNobody, kNobody) == 0)
            changed_ = seteuid(kNobody) == 0;
    }
    ~PlainUser()
    {
        if (changed_)
            (void)!seteuid(0);
    }
    PlainUser(const PlainUser&) = delete;
    PlainUser& operator=(const PlainUser&) = delete;

private:
    static constexpr uid_t kNobody = 65534;
    bool changed_ = false;
};
