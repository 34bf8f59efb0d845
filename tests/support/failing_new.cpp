#include "support/failing_new.h"

#include <algorithm>
#include <cstdlib>
#include <malloc.h>
#include <new>

namespace reisti::test {
namespace {

// One per thread, so that other threads of the program never meet a failure meant for the watched call.
thread_local AllocationWatch* activeWatch = nullptr;

void* allocate(std::size_t size, std::size_t alignment) noexcept {
    if (activeWatch != nullptr && !activeWatch->admit()) return nullptr;
    const std::size_t bytes = std::max<std::size_t>(size, 1);
    void* block = nullptr;
    if (alignment <= alignof(std::max_align_t)) {
        block = std::malloc(bytes);
    } else if (bytes + (alignment - 1) >= bytes) {
        block = std::aligned_alloc(alignment, (bytes + (alignment - 1)) / alignment * alignment);
    }
    if (activeWatch != nullptr && block != nullptr) activeWatch->noteAllocated(block);
    return block;
}

void* allocateOrThrow(std::size_t size, std::size_t alignment) {
    void* block = allocate(size, alignment);
    if (block == nullptr) throw std::bad_alloc();
    return block;
}

void release(void* block) noexcept {
    if (activeWatch != nullptr && block != nullptr) activeWatch->noteFreed(block);
    std::free(block);
}

constexpr std::size_t kDefaultAlignment = alignof(std::max_align_t);

}  // namespace

AllocationWatch::AllocationWatch(std::size_t failNth) : failNth_(failNth) {
    activeWatch = this;
}

AllocationWatch::~AllocationWatch() {
    stop();
}

void AllocationWatch::stop() {
    if (activeWatch == this) activeWatch = nullptr;
}

bool AllocationWatch::admit() {
    ++counts_.attempts;
    if (failNth_ == kNeverFail || counts_.attempts != failNth_) return true;
    counts_.failed = true;
    return false;
}

void AllocationWatch::noteAllocated(void* block) {
    ++counts_.liveBlocks;
    counts_.liveBytes += static_cast<std::ptrdiff_t>(malloc_usable_size(block));
    counts_.peakBytes = std::max(counts_.peakBytes, counts_.liveBytes);
}

void AllocationWatch::noteFreed(void* block) {
    --counts_.liveBlocks;
    counts_.liveBytes -= static_cast<std::ptrdiff_t>(malloc_usable_size(block));
}

}  // namespace reisti::test

using reisti::test::allocate;
using reisti::test::allocateOrThrow;
using reisti::test::kDefaultAlignment;
using reisti::test::release;

void* operator new(std::size_t size) {
    return allocateOrThrow(size, kDefaultAlignment);
}
void* operator new[](std::size_t size) {
    return allocateOrThrow(size, kDefaultAlignment);
}
void* operator new(std::size_t size, const std::nothrow_t&) noexcept {
    return allocate(size, kDefaultAlignment);
}
void* operator new[](std::size_t size, const std::nothrow_t&) noexcept {
    return allocate(size, kDefaultAlignment);
}
void* operator new(std::size_t size, std::align_val_t alignment) {
    return allocateOrThrow(size, static_cast<std::size_t>(alignment));
}
void* operator new[](std::size_t size, std::align_val_t alignment) {
    return allocateOrThrow(size, static_cast<std::size_t>(alignment));
}
void* operator new(std::size_t size, std::align_val_t alignment, const std::nothrow_t&) noexcept {
    return allocate(size, static_cast<std::size_t>(alignment));
}
void* operator new[](std::size_t size, std::align_val_t alignment, const std::nothrow_t&) noexcept {
    return allocate(size, static_cast<std::size_t>(alignment));
}

void operator delete(void* block) noexcept {
    release(block);
}
void operator delete[](void* block) noexcept {
    release(block);
}
void operator delete(void* block, std::size_t) noexcept {
    release(block);
}
void operator delete[](void* block, std::size_t) noexcept {
    release(block);
}
void operator delete(void* block, const std::nothrow_t&) noexcept {
    release(block);
}
void operator delete[](void* block, const std::nothrow_t&) noexcept {
    release(block);
}
void operator delete(void* block, std::align_val_t) noexcept {
    release(block);
}
void operator delete[](void* block, std::align_val_t) noexcept {
    release(block);
}
void operator delete(void* block, std::size_t, std::align_val_t) noexcept {
    release(block);
}
void operator delete[](void* block, std::size_t, std::align_val_t) noexcept {
    release(block);
}
void operator delete(void* block, std::align_val_t, const std::nothrow_t&) noexcept {
    release(block);
}
void operator delete[](void* block, std::align_val_t, const std::nothrow_t&) noexcept {
    release(block);
}
