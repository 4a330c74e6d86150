#pragma once

#include "storage/DataFolder.h"
#include "storage/Descriptor.h"

#include <chrono>
#include <string>

/// Held by a save from before it keeps the old file until the new one has its place: nobody else saves in that folder
/// meanwhile, so that of two programs the later one keeps what the earlier one has saved.
///
/// What is locked is the folder of the file itself, because there all meet who save the file, whichever link or data
/// folder they use. Where that folder may not be read, or knows no locks, it is the file ".lock" in "Backups" instead:
/// then all meet who have the same data folder. The kernel takes the lock from a program that ends, however it does,
/// so none is left behind. Some file systems of a network know the locks of their own machine only.
class SaveLock {
public:
    using Patience = std::chrono::milliseconds;

    /// Locks for a save of the file at `path` (absolute, no links). Throws an AtomicFile::WriteError when another
    /// program holds the lock for longer than `patience`, or when there can be no lock.
    SaveLock(const std::string& path, const DataFolder& folder, Patience patience);

private:
    Descriptor descriptor_;
};
