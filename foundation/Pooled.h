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
/// Freed places are used again; the blocks go back to the system when the last object is gone. Under AddressSanitizer
/// each object is an allocation of its own, so that misuse is still found.
template <class T>
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
            addBlock();
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
            releaseBlocks();
#endif
    }

protected:
    ~Pooled() = default;

private:
    struct Place {
        Place* next;
    };
    struct Block {
        Block* previous;
    };

    static constexpr std::size_t kHugePage = std::size_t{2} << 20;
    static constexpr std::size_t kHeader = 64; // keeps objects of a cache line on one line

    static void addBlock()
    {
        void* memory = std::aligned_alloc(kHugePage, kHugePage);
        if (memory == nullptr)
            throw std::bad_alloc();
        // One page fault instead of 512; only advice, so a refusal does not matter. The first block is spared: a
        // small portfolio should not hold two megabytes for a few objects.
        if (blocks_ != nullptr)
            (void)madvise(memory, kHugePage, MADV_HUGEPAGE);
        blocks_ = new (memory) Block{blocks_};
        next_ = static_cast<char*>(memory) + kHeader;
        end_ = static_cast<char*>(memory) + kHugePage;
    }

    static void releaseBlocks() noexcept
    {
        while (blocks_ != nullptr) {
            Block* previous = blocks_->previous;
            std::free(blocks_);
            blocks_ = previous;
        }
        free_ = nullptr;
        next_ = end_ = nullptr;
    }

    static inline Block* blocks_ = nullptr;
    static inline Place* free_ = nullptr;
    static inline char* next_ = nullptr;
    static inline char* end_ = nullptr;
    static inline std::size_t live_ = 0;
};
