#pragma once

#include <unistd.h>

/// Closes a file descriptor in the end. A negative number stands for none: opening has failed, for the reason in errno.
struct Descriptor {
    explicit Descriptor(int aNumber) : number(aNumber) {}
    ~Descriptor()
    {
        if (number >= 0)
            close(number);
    }
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;

    const int number;
};
