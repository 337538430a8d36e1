#include "kestrel/translate/LoadArena.h"

#include <gtest/gtest.h>

#include <cstring>
#include <vector>
#include <xercesc/util/OutOfMemoryException.hpp>
#include <xercesc/util/PlatformUtils.hpp>

#include "kestrel/translate/ParserPlatform.h"

namespace {

using MCKestrel_800::LoadArena;

constexpr size_t kMega = size_t{1} << 20;

TEST(LoadArena, GivesAlignedPiecesThatDoNotOverlap) {
  LoadArena arena(100 * kMega, 1000000, 0, 0);
  std::vector<std::pair<unsigned char*, size_t>> pieces;
  for (size_t i = 0; i < 3000; ++i) {
    const size_t size = i * i % 5000;
    auto* const piece = static_cast<unsigned char*>(arena.allocate(size));
    EXPECT_EQ(reinterpret_cast<size_t>(piece) % alignof(std::max_align_t), 0u);
    std::memset(piece, static_cast<int>(i % 251), size);
    pieces.emplace_back(piece, size);
    if (i % 3 == 0) {  // every third is given back at once or later
      const size_t victim = i % 2 == 0 ? i : i / 2;
      arena.deallocate(pieces[victim].first);
      pieces[victim].second = 0;
      if (victim != i) pieces[victim].first = nullptr;
    }
  }
  for (size_t i = 0; i < pieces.size(); ++i) {
    for (size_t k = 0; k < pieces[i].second; ++k)
      ASSERT_EQ(pieces[i].first[k], i % 251) << i;
  }
}

TEST(LoadArena, UsesFreedPiecesAgain) {
  LoadArena arena(kMega, 1000000, 0, 0);
  for (int i = 0; i < 10000; ++i) {
    void* const first = arena.allocate(150000);
    void* const second = arena.allocate(100);
    arena.deallocate(first);
    arena.deallocate(second);
  }
  EXPECT_LE(arena.GetPeakBytes(), kMega);
}

TEST(LoadArena, GivesLargePiecesBack) {
  LoadArena arena(100 * kMega, 1000000, 0, 0);
  const size_t before = arena.GetHeldBytes();
  void* const first = arena.allocate(10 * kMega);
  void* const second = arena.allocate(20 * kMega);
  void* const third = arena.allocate(30 * kMega);
  EXPECT_GE(arena.GetHeldBytes(), before + 60 * kMega);
  arena.deallocate(second);
  arena.deallocate(first);
  arena.deallocate(third);
  EXPECT_EQ(arena.GetHeldBytes(), before);
  EXPECT_GE(arena.GetPeakBytes(), 60 * kMega);
}

TEST(LoadArena, RefusesPastTheBytes) {
  LoadArena arena(2 * kMega, 1000000, 0, 0);
  EXPECT_NO_THROW(arena.allocate(kMega));
  EXPECT_FALSE(arena.IsRefused());
  EXPECT_THROW(arena.allocate(kMega + 1000), xercesc::OutOfMemoryException);
  EXPECT_TRUE(arena.IsRefused());
  EXPECT_NO_THROW(arena.allocate(100)) << "what fits is still granted, so that cleaning up works";
}

TEST(LoadArena, RefusesPastTheCalls) {
  LoadArena arena(kMega, 3, 0, 0);
  for (int i = 0; i < 3; ++i)
    arena.deallocate(arena.allocate(10));
  EXPECT_THROW(arena.allocate(10), xercesc::OutOfMemoryException);
  EXPECT_TRUE(arena.IsRefused());
  EXPECT_EQ(arena.GetCalls(), 4u);
}

TEST(LoadArena, GrantsTheReserveAndSaysSo) {
  LoadArena arena(2 * kMega, 100, 4 * kMega, 10);
  arena.allocate(kMega);
  EXPECT_FALSE(arena.IsRefused());
  EXPECT_NO_THROW(arena.allocate(2 * kMega));
  EXPECT_TRUE(arena.IsRefused());
  EXPECT_THROW(arena.allocate(3 * kMega), xercesc::OutOfMemoryException);
  LoadArena counting(kMega, 5, 0, 3);
  for (int i = 0; i < 8; ++i)
    EXPECT_NO_THROW(counting.allocate(1));
  EXPECT_TRUE(counting.IsRefused());
  EXPECT_THROW(counting.allocate(1), xercesc::OutOfMemoryException);
}

// Asks for memory when it goes, as the parser's own objects do.
class AskingAtItsEnd {
 public:
  explicit AskingAtItsEnd(LoadArena& arena) : arena_(arena) {}
  ~AskingAtItsEnd() { arena_.deallocate(arena_.allocate(2 * kMega)); }

 private:
  LoadArena& arena_;
};

TEST(LoadArena, GrantsWhatDestructorsAskForDuringAnException) {
  LoadArena arena(kMega, 1, 0, 0);
  try {
    const AskingAtItsEnd asking(arena);
    arena.allocate(1);
    arena.allocate(1);
    FAIL() << "nothing was thrown";
  } catch (const xercesc::OutOfMemoryException&) {
  }
  EXPECT_THROW(arena.allocate(1), xercesc::OutOfMemoryException) << "but nothing afterwards";
}

TEST(LoadArena, RefusesSizesThatNobodyHas) {
  LoadArena arena(SIZE_MAX, SIZE_MAX, 0, 0);
  for (size_t size : {SIZE_MAX, SIZE_MAX - 15, SIZE_MAX / 2 + 1, SIZE_MAX / 4}) {
    EXPECT_THROW(arena.allocate(size), xercesc::OutOfMemoryException) << size;
  }
}

TEST(LoadArena, GrantsEverythingOnceTheQuotaIsLifted) {
  LoadArena arena(1000, 1, 0, 0);
  arena.LiftQuota();
  for (int i = 0; i < 10; ++i)
    EXPECT_NO_THROW(arena.allocate(kMega));
}

TEST(LoadArena, FreesNothingForNull) {
  LoadArena arena(1000, 10, 0, 0);
  EXPECT_NO_THROW(arena.deallocate(nullptr));
}

// An exception may be looked at after the load's memory is gone.
TEST(LoadArena, LeavesExceptionsToTheProcess) {
  MCKestrel_800::RequireParser();
  LoadArena arena(1000, 10, 0, 0);
  EXPECT_EQ(arena.getExceptionMemoryManager(), xercesc::XMLPlatformUtils::fgMemoryManager);
}

}  // namespace
