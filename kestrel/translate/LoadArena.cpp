#include "kestrel/translate/LoadArena.h"

#include <algorithm>
#include <cstdint>
#include <exception>
#include <xercesc/util/OutOfMemoryException.hpp>
#include <xercesc/util/PlatformUtils.hpp>

#include "kestrel/platform/PageMemory.h"

namespace MCKestrel_800 {

namespace {

constexpr size_t kAlignment = alignof(std::max_align_t);
constexpr size_t kFirstChunkBytes = size_t{64} << 10;
constexpr size_t kMaxChunkBytes = size_t{8} << 20;
// The tree takes its memory in blocks of up to half a megabyte and never frees them: those are cut from
// chunks.
constexpr size_t kLargeBytes = size_t{1} << 20;

constexpr size_t RoundUp(size_t size) {
  return (size + kAlignment - 1) / kAlignment * kAlignment;
}

}  // namespace

// Stands in front of what a chunk holds.
struct alignas(std::max_align_t) LoadArena::Chunk {
  Chunk* previous;
  Chunk* next;
  size_t bytes;  // with this header
};

// Stands in front of every piece handed out.
struct alignas(std::max_align_t) LoadArena::Block {
  size_t size;   // without this header
  Chunk* large;  // the chunk of its own, or null
  // While the piece is free its first bytes hold the next free one.
  Block*& NextFree() { return *reinterpret_cast<Block**>(this + 1); }
};

LoadArena::LoadArena(size_t maxBytes, size_t maxCalls, size_t reserveBytes, size_t reserveCalls)
    : maxBytes_(maxBytes),
      maxCalls_(maxCalls),
      reserveBytes_(reserveBytes),
      reserveCalls_(reserveCalls),
      exceptionsBefore_(std::uncaught_exceptions()),
      nextChunkBytes_(kFirstChunkBytes) {}

LoadArena::~LoadArena() {
  for (Chunk* chunk = chunks_; chunk != nullptr;) {
    Chunk* const next = chunk->next;
    FreePages(chunk, chunk->bytes);
    chunk = next;
  }
}

xercesc::MemoryManager* LoadArena::getExceptionMemoryManager() {
  return xercesc::XMLPlatformUtils::fgMemoryManager;
}

void LoadArena::LiftQuota() {
  maxBytes_ = SIZE_MAX;
  maxCalls_ = SIZE_MAX;
}

void* LoadArena::allocate(XMLSize_t requested) {
  if (++calls_ > maxCalls_) {
    refused_ = true;
    if (calls_ - maxCalls_ > reserveCalls_ && MayRefuse()) throw xercesc::OutOfMemoryException();
  }
  if (requested > SIZE_MAX / 2) throw xercesc::OutOfMemoryException();
  const size_t size = RoundUp(std::max<size_t>(requested, 1));
  if (size >= kLargeBytes) return NewLargeBlock(size);
  if (void* const reused = Reuse(size)) return reused;
  if (static_cast<size_t>(freeEnd_ - free_) < size + sizeof(Block)) NewChunk(size + sizeof(Block));
  Block* const block = reinterpret_cast<Block*>(free_);
  block->size = size;
  block->large = nullptr;
  free_ += sizeof(Block) + size;
  return block + 1;
}

void LoadArena::deallocate(void* p) {
  if (p == nullptr) return;
  Block* const block = static_cast<Block*>(p) - 1;
  if (block->large != nullptr) {
    DropChunk(block->large);
    return;
  }
  char* const end = static_cast<char*>(p) + block->size;
  if (end == free_) {  // the newest piece: most buffers that grow are
    free_ = reinterpret_cast<char*>(block);
    return;
  }
  Block*& first = reusable_[SizeClass(block->size)];
  block->NextFree() = first;
  first = block;
}

// While the parser unwinds its destructors must get what they ask for.
bool LoadArena::MayRefuse() const {
  return std::uncaught_exceptions() <= exceptionsBefore_;
}

// The number of the highest bit that is set.
size_t LoadArena::SizeClass(size_t size) {
  size_t result = 0;
  while (size >>= 1)
    ++result;
  return result;
}

// Looks at the newest freed piece of the request's own class, which is the one that fits when the same thing
// is made again and again, and of the class above, where every piece fits. Anything more thorough would cost
// more than it saves.
void* LoadArena::Reuse(size_t size) {
  const size_t own = SizeClass(size);
  for (size_t sizeClass = own; sizeClass <= own + 1; ++sizeClass) {
    Block* const block = reusable_[sizeClass];
    if (block == nullptr || block->size < size) continue;
    reusable_[sizeClass] = block->NextFree();
    return block + 1;
  }
  return nullptr;
}

void* LoadArena::NewLargeBlock(size_t size) {
  Chunk* const chunk = TakeChunk(sizeof(Chunk) + sizeof(Block) + size);
  Block* const block = reinterpret_cast<Block*>(chunk + 1);
  block->size = size;
  block->large = chunk;
  return block + 1;
}

void LoadArena::NewChunk(size_t atLeast) {
  const size_t bytes = std::max(nextChunkBytes_, sizeof(Chunk) + atLeast);
  Chunk* const chunk = TakeChunk(bytes);
  nextChunkBytes_ = std::min(nextChunkBytes_ * 2, kMaxChunkBytes);
  free_ = reinterpret_cast<char*>(chunk + 1);
  freeEnd_ = reinterpret_cast<char*>(chunk) + bytes;
}

LoadArena::Chunk* LoadArena::TakeChunk(size_t bytes) {
  if (bytes > maxBytes_ || heldBytes_ > maxBytes_ - bytes) {
    refused_ = true;
    // Held bytes may be past the quota already, by part of the reserve.
    const bool fitsReserve = bytes <= reserveBytes_ && heldBytes_ + bytes - maxBytes_ <= reserveBytes_;
    if (!fitsReserve && MayRefuse()) throw xercesc::OutOfMemoryException();
  }
  void* const memory = AllocatePages(bytes);
  if (memory == nullptr) {
    refused_ = true;
    throw xercesc::OutOfMemoryException();
  }
  Chunk* const chunk = static_cast<Chunk*>(memory);
  chunk->previous = nullptr;
  chunk->next = chunks_;
  chunk->bytes = bytes;
  if (chunks_ != nullptr) chunks_->previous = chunk;
  chunks_ = chunk;
  heldBytes_ += bytes;
  peakBytes_ = std::max(peakBytes_, heldBytes_);
  return chunk;
}

void LoadArena::DropChunk(Chunk* chunk) {
  if (chunk->previous != nullptr) {
    chunk->previous->next = chunk->next;
  } else {
    chunks_ = chunk->next;
  }
  if (chunk->next != nullptr) chunk->next->previous = chunk->previous;
  heldBytes_ -= chunk->bytes;
  FreePages(chunk, chunk->bytes);
}

}  // namespace MCKestrel_800
