// Host memory: every text and list the host hands out, counted until log_free releases it.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace wb {

// Blocks come from slabs the host owns, each behind a small header with a magic value, so a
// release can tell a live block from a freed one or a foreign pointer without touching memory
// it does not own: a pointer is first located among the slabs, and only then is its header read.
// Freed blocks go to per-size free lists; under the address sanitizer their contents are
// poisoned, so a plug-in that keeps using a released text is caught.
class HostMemory {
 public:
  HostMemory() = default;
  ~HostMemory();
  HostMemory(const HostMemory&) = delete;
  HostMemory& operator=(const HostMemory&) = delete;

  char* DuplicateText(const std::string& text) { return DuplicateText(text.data(), text.size()); }
  // A terminated copy of `length` bytes.
  char* DuplicateText(const char* text, std::size_t length);
  void* Allocate(std::size_t bytes);
  // Answers false (and changes nothing but the count of bad releases) when the pointer is no
  // live host allocation: freed already, foreign, or pointing inside a block. Null is a no-op.
  bool Release(void* memory);
  // Gives every slab back; counts start again from zero.
  void Clear();

  std::int64_t Outstanding() const { return outstanding_; }
  std::int64_t TotalHandedOut() const { return total_; }
  std::int64_t BadReleases() const { return badReleases_; }

 private:
  struct BlockHeader;
  struct Slab {
    std::byte* begin;
    std::byte* end;
    std::uint32_t sizeClass;  // kLargeClass: one block spanning the whole slab
  };
  static constexpr std::uint32_t kClassCount = 8;  // blocks of 32 << class bytes, header included
  static constexpr std::uint32_t kLargeClass = kClassCount;

  BlockHeader* TakeBlock(std::uint32_t sizeClass);
  BlockHeader* NewLargeBlock(std::size_t bytes);
  void AddSlab(const Slab& slab);
  std::vector<Slab>::iterator SlabHolding(const std::byte* address);

  std::vector<Slab> slabs_;  // sorted by address
  std::array<BlockHeader*, kClassCount> freeBlocks_{};
  std::array<std::byte*, kClassCount> carveNext_{};  // untouched rest of each class's newest slab
  std::array<std::byte*, kClassCount> carveEnd_{};
  std::int64_t outstanding_ = 0;
  std::int64_t total_ = 0;
  std::int64_t badReleases_ = 0;
};

}  // namespace wb
