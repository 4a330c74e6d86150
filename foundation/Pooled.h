#pragma once

#include <cstddef>
#include <cstdlib>
#include <new>
#include <sys/mman.h>

#if defined(__SANITIZE_ADDRESS__)
#define PELORIN_PLAIN_ALLOCATION 1
#elif defined(__has_feature)
#if __has_feature(address_sanitizer)
#define PELORIN_PLAIN_ALLOCATION 1
#endif
#endif

/// Memory for a class of which there are millions: `class T : public Pooled<T>` makes `new T` and `delete` take places
/// from large blocks, without the header and search that each general allocation costs.
///
/// Freed places are used again. When the last object is gone, blocks up to `kKeptBytes` stay for the next ones, because
/// the system clears each page that it hands out anew; the others, and on `releaseKept` all, go back to the system.
/// Under AddressSanitizer each object is an allocation of its own, so that misuse is still found.
template <class T, std::size_t kKeptBytes = 0>
class Pooled {
public:
    static void* operator new(std::size_t size)
    {
#ifdef PELORIN_PLAIN_ALLOCATION
        return ::operator new(size);
#else
        if (size != sizeof(T)) // a class derived from T
            return ::operator new(size);
        ++live_;
        if (free_ != nullptr) {
            Place* place = free_;
            free_ = place->next;
            return place;
        }
        if (static_cast<std::size_t>(end_ - next_) < sizeof(T))
            openNextBlock();
        void* place = next_;
        next_ += sizeof(T);
        return place;
#endif
    }

    static void operator delete(void* p, std::size_t size) noexcept
    {
#ifdef PELORIN_PLAIN_ALLOCATION
        ::operator delete(p, size);
#else
        if (size != sizeof(T)) {
            ::operator delete(p);
            return;
        }
        free_ = new (p) Place{free_};
        if (--live_ == 0)
            releaseBlocks(kKeptBlocks);
#endif
    }

    /// Takes back the places of all objects at once, without destroying them, if there are `count`: for one who knows
    /// so many, and so all of them, and then forgets them. @return false, when there are others, and nothing is done.
    static bool takeBackAll([[maybe_unused]] std::size_t count) noexcept
    {
#ifdef PELORIN_PLAIN_ALLOCATION
        return false;
#else
        if (live_ != count)
            return false;
        live_ = 0;
        releaseBlocks(kKeptBlocks);
        return true;
#endif
    }

    /// Gives back what is kept for objects to come, unless there are any now.
    static void releaseKept() noexcept
    {
        if (live_ == 0)
            releaseBlocks(0);
    }

protected:
    ~Pooled() = default;

private:
    struct Place {
        Place* next;
    };
    struct Block {
        Block* next;
    };

    static constexpr std::size_t kHugePage = std::size_t{2} << 20;
    static constexpr std::size_t kHeader = 64; // keeps objects of a cache line on one line
    static constexpr std::size_t kKeptBlocks = kKeptBytes / kHugePage;

    /// Lets places be taken from the block behind the open one, which is full; from the first when none is open.
    static void openNextBlock()
    {
        Block*& next = open_ != nullptr ? open_->next : first_;
        if (next == nullptr)
            next = newBlock();
        open_ = next;
        next_ = reinterpret_cast<char*>(open_) + kHeader;
        end_ = reinterpret_cast<char*>(open_) + kHugePage;
    }

    static Block* newBlock()
    {
        void* memory = std::aligned_alloc(kHugePage, kHugePage);
        if (memory == nullptr)
            throw std::bad_alloc();
        // One page fault instead of 512; only advice, so a refusal does not matter. The first block is spared: a
        // small portfolio should not hold two megabytes for a few objects.
        if (first_ != nullptr)
            (void)madvise(memory, kHugePage, MADV_HUGEPAGE);
        return new (memory) Block{nullptr};
    }

    /// No object lives. Afterwards up to `kept` blocks are there, all of them empty, and none is open.
    static void releaseBlocks(std::size_t kept) noexcept
    {
        Block** end = &first_;
        while (*end != nullptr && kept-- > 0)
            end = &(*end)->next;
        Block* block = *end;
        *end = nullptr;
        while (block != nullptr) {
            Block* next = block->next;
            std::free(block);
            block = next;
        }
        open_ = nullptr;
        free_ = nullptr;
        next_ = end_ = nullptr;
    }

    static inline Block* first_ = nullptr; // the blocks, in the order in which they are filled
    static inline Block* open_ = nullptr;  // the one that places are taken from; those behind it are empty
    static inline Place* free_ = nullptr;  // places that objects have left
    static inline char* next_ = nullptr;   // the rest of the open block
    static inline char* end_ = nullptr;
    static inline std::size_t live_ = 0;
};
