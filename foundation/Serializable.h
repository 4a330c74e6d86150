#pragma once

#include <cstdio>

/// An object that has a record in one of the data files.
///
/// Both operations work at the stream's current position and return 0, or -1 on failure. A reader that meets the end of
/// the file returns -1, unless its class says otherwise; numbers it could not read hold the bytes 0xFF.
class Serializable {
public:
    virtual int wrt(FILE* file) const = 0;
    virtual int rd(FILE* file) = 0;

protected:
    Serializable() = default;
    Serializable(const Serializable&) = default;
    Serializable& operator=(const Serializable&) = default;
    ~Serializable() = default; // objects are destroyed through their own class, never through this one
};
