// The memory of one load: it comes from here alone, is bounded by a quota, and is freed at once.

#ifndef KESTREL_TRANSLATE_LOADARENA_H
#define KESTREL_TRANSLATE_LOADARENA_H

#include <xercesc/framework/MemoryManager.hpp>

#include <cstddef>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// Gives the parser and the tree their memory. A quota stops every document that asks for far more than its
/// size explains, whatever trick it uses, and because the arena owns all blocks, giving up at any point leaks
/// nothing.
///
/// Small requests are cut from chunks that double in size; freed ones are kept for requests of about their
/// size. Large requests have a chunk of their own, which is given back when they are freed. Errors:
/// `allocate` throws xercesc::OutOfMemoryException past the quota, as the parser expects of a memory manager.
/// Threads: one arena serves one thread at a time.
class KESTREL_API LoadArena final : public xercesc::MemoryManager {
 public:
  /// maxBytes  memory that may be held from the system at one time.
  /// maxCalls  requests that may be made, so that work which frees what it takes ends as well.
  /// reserveBytes, reserveCalls  what is granted beyond that.
  LoadArena(size_t maxBytes, size_t maxCalls, size_t reserveBytes, size_t reserveCalls);
  ~LoadArena() override;
  LoadArena(const LoadArena&) = delete;
  LoadArena& operator=(const LoadArena&) = delete;

  void* allocate(XMLSize_t size) override;
  void deallocate(void* p) override;
  /// Exceptions may outlive the load, so their texts come from the process's own memory.
  xercesc::MemoryManager* getExceptionMemoryManager() override;

  /// From now on everything is granted: the tree is complete, and reading it must not fail.
  void LiftQuota();

  bool IsRefused() const { return refused_; }         ///< whether the quota was exceeded
  size_t GetHeldBytes() const { return heldBytes_; }  ///< memory held from the system
  size_t GetPeakBytes() const { return peakBytes_; }  ///< the most that was held at one time
  size_t GetCalls() const { return calls_; }          ///< requests made

 private:
  struct Chunk;
  struct Block;

  bool MayRefuse() const;
  static size_t SizeClass(size_t size);
  void* Reuse(size_t size);
  void* NewLargeBlock(size_t size);
  void NewChunk(size_t atLeast);
  Chunk* TakeChunk(size_t bytes);
  void DropChunk(Chunk* chunk);

  size_t maxBytes_;
  size_t maxCalls_;
  size_t reserveBytes_;
  size_t reserveCalls_;
  int exceptionsBefore_;  // under way when the load began
  size_t heldBytes_ = 0;
  size_t peakBytes_ = 0;
  size_t calls_ = 0;
  bool refused_ = false;
  size_t nextChunkBytes_;
  char* free_ = nullptr;  // what is left of the newest shared chunk
  char* freeEnd_ = nullptr;
  Chunk* chunks_ = nullptr;  // all chunks, doubly linked
  static constexpr size_t kClasses = 64;
  Block* reusable_[kClasses] = {};  // freed small blocks by the power of two below their size
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_LOADARENA_H
