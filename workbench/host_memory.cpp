// Slab allocator behind the host's texts and lists, with release checks that never crash.
#include "workbench/host_memory.h"

#if __has_include(<sanitizer/asan_interface.h>)
#include <sanitizer/asan_interface.h>
#else  // a toolchain without sanitizers (MinGW): the poisoning marks are no-ops there too
#define ASAN_POISON_MEMORY_REGION(address, size) ((void)(address), (void)(size))
#define ASAN_UNPOISON_MEMORY_REGION(address, size) ((void)(address), (void)(size))
#endif

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <functional>
#include <iterator>
#include <new>

namespace wb {

struct HostMemory::BlockHeader {
  std::uint32_t magic;
  std::uint32_t sizeClass;
  BlockHeader* nextFree;  // kept in the header so a poisoned payload is never read
};

namespace {

constexpr std::uint32_t kLiveMagic = 0x4C495645;   // "LIVE"
constexpr std::uint32_t kFreedMagic = 0x46524545;  // "FREE"
constexpr std::size_t kHeaderSize = 16;
constexpr std::size_t kSlabBytes = 64 * 1024;
static_assert(sizeof(void*) <= 8 && 2 * sizeof(std::uint32_t) + sizeof(void*) <= kHeaderSize);

constexpr std::size_t BlockBytes(std::uint32_t sizeClass) { return std::size_t{32} << sizeClass; }

std::byte* PayloadOf(void* header) { return static_cast<std::byte*>(header) + kHeaderSize; }

bool Below(const std::byte* a, const std::byte* b) { return std::less<const std::byte*>{}(a, b); }

}  // namespace

HostMemory::~HostMemory() { Clear(); }

void HostMemory::Clear() {
  for (const Slab& slab : slabs_) {
    ASAN_UNPOISON_MEMORY_REGION(slab.begin, static_cast<std::size_t>(slab.end - slab.begin));
    std::free(slab.begin);
  }
  slabs_.clear();
  freeBlocks_.fill(nullptr);
  carveNext_.fill(nullptr);
  carveEnd_.fill(nullptr);
  outstanding_ = 0;
  total_ = 0;
  badReleases_ = 0;
}

char* HostMemory::DuplicateText(const char* text, std::size_t length) {
  auto* copy = static_cast<char*>(Allocate(length + 1));
  if (length != 0) std::memcpy(copy, text, length);
  copy[length] = '\0';
  return copy;
}

void* HostMemory::Allocate(std::size_t bytes) {
  std::uint32_t sizeClass = 0;
  while (sizeClass < kClassCount && BlockBytes(sizeClass) - kHeaderSize < bytes) ++sizeClass;
  BlockHeader* header = sizeClass < kClassCount ? TakeBlock(sizeClass) : NewLargeBlock(bytes);
  header->magic = kLiveMagic;
  header->nextFree = nullptr;
  ++outstanding_;
  ++total_;
  std::byte* payload = PayloadOf(header);
  ASAN_UNPOISON_MEMORY_REGION(payload, bytes);
  return payload;
}

HostMemory::BlockHeader* HostMemory::TakeBlock(std::uint32_t sizeClass) {
  if (BlockHeader* reused = freeBlocks_[sizeClass]) {
    freeBlocks_[sizeClass] = reused->nextFree;
    return reused;
  }
  const std::size_t blockBytes = BlockBytes(sizeClass);
  if (carveNext_[sizeClass] == carveEnd_[sizeClass]) {
    // Zeroed, so a header that was never handed out can never read as live.
    auto* begin = static_cast<std::byte*>(std::calloc(1, kSlabBytes));
    if (begin == nullptr) throw std::bad_alloc();
    AddSlab(Slab{begin, begin + kSlabBytes, sizeClass});
    carveNext_[sizeClass] = begin;
    carveEnd_[sizeClass] = begin + kSlabBytes;
  }
  auto* header = reinterpret_cast<BlockHeader*>(carveNext_[sizeClass]);
  carveNext_[sizeClass] += blockBytes;
  header->sizeClass = sizeClass;
  return header;
}

HostMemory::BlockHeader* HostMemory::NewLargeBlock(std::size_t bytes) {
  auto* begin = static_cast<std::byte*>(std::calloc(1, kHeaderSize + bytes));
  if (begin == nullptr) throw std::bad_alloc();
  AddSlab(Slab{begin, begin + kHeaderSize + bytes, kLargeClass});
  auto* header = reinterpret_cast<BlockHeader*>(begin);
  header->sizeClass = kLargeClass;
  return header;
}

void HostMemory::AddSlab(const Slab& slab) {
  auto at = std::upper_bound(slabs_.begin(), slabs_.end(), slab.begin,
                             [](const std::byte* address, const Slab& s) { return Below(address, s.begin); });
  slabs_.insert(at, slab);
}

std::vector<HostMemory::Slab>::iterator HostMemory::SlabHolding(const std::byte* address) {
  auto after = std::upper_bound(slabs_.begin(), slabs_.end(), address,
                                [](const std::byte* a, const Slab& s) { return Below(a, s.begin); });
  if (after == slabs_.begin()) return slabs_.end();
  auto slab = std::prev(after);
  return Below(address, slab->end) ? slab : slabs_.end();
}

bool HostMemory::Release(void* memory) {
  if (memory == nullptr) return true;
  const auto* payload = static_cast<const std::byte*>(memory);
  auto slab = SlabHolding(payload);
  // Only a pointer exactly at a block's payload may have its header read.
  bool atPayload = false;
  if (slab != slabs_.end()) {
    const auto offset = static_cast<std::size_t>(payload - slab->begin);
    atPayload =
        slab->sizeClass == kLargeClass ? offset == kHeaderSize : offset % BlockBytes(slab->sizeClass) == kHeaderSize;
  }
  auto* header = atPayload ? reinterpret_cast<BlockHeader*>(const_cast<std::byte*>(payload) - kHeaderSize) : nullptr;
  if (header == nullptr || header->magic != kLiveMagic) {
    ++badReleases_;
    return false;
  }
  --outstanding_;
  if (slab->sizeClass == kLargeClass) {
    std::free(slab->begin);
    slabs_.erase(slab);
    return true;
  }
  header->magic = kFreedMagic;
  header->nextFree = freeBlocks_[header->sizeClass];
  freeBlocks_[header->sizeClass] = header;
  ASAN_POISON_MEMORY_REGION(PayloadOf(header), BlockBytes(header->sizeClass) - kHeaderSize);
  return true;
}

}  // namespace wb
