#include "kestrel/platform/ThreadObject.h"

#include <gtest/gtest.h>

#include <atomic>
#include <string>
#include <thread>
#include <vector>

namespace {

using MCKestrel_800::ThreadObject;

std::atomic<int> alive{0};
std::atomic<int> wrong{0};

struct Counted {
  Counted() { ++alive; }
  ~Counted() {
    --alive;
    // A destructor that looks at its members, as those of real objects do.
    if (text != std::string(100, 'x')) ++wrong;
  }
  Counted(const Counted&) = delete;
  Counted& operator=(const Counted&) = delete;

  int calls = 0;
  std::string text = std::string(100, 'x');
};

TEST(ThreadObject, IsEachThreadsOwnAndGoesWithIt) {
  const int before = alive;
  Counted& own = ThreadObject<Counted>();
  own.calls = 7;
  for (int round = 0; round < 20; ++round) {
    std::vector<std::thread> threads;
    for (int i = 0; i < 8; ++i) {
      threads.emplace_back([&own] {
        for (int call = 1; call <= 3; ++call) {
          Counted& object = ThreadObject<Counted>();
          if (&object == &own || ++object.calls != call) ++wrong;
        }
      });
    }
    for (std::thread& thread : threads)
      thread.join();
  }
  EXPECT_EQ(alive, before + 1) << "this thread's own is left";
  EXPECT_EQ(&ThreadObject<Counted>(), &own);
  EXPECT_EQ(own.calls, 7);
  EXPECT_EQ(wrong, 0);
}

}  // namespace
