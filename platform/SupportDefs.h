#pragma once

#include <cstdint>

using int32 = std::int32_t;
using uint32 = std::uint32_t;
/// A span of time in microseconds.
using bigtime_t = std::int64_t;

/// Outcome of a call: `B_OK`, or a negative error.
using status_t = int32;

enum : status_t {
    B_OK = 0,
    B_ERROR = -1,
    B_BAD_VALUE = -2,      ///< an argument that makes no sense here
    B_NAME_NOT_FOUND = -3, ///< a message holds nothing under this name
    B_NO_INIT = -5,        ///< the object was never told what it stands for
};
