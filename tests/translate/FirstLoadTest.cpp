// The very first loads of a process, all at the same time. A program of its own, since only one load is the
// first.

#include <gtest/gtest.h>

#include <atomic>
#include <thread>
#include <vector>

#include "kestrel/translate/XmlText.h"
#include "tests/support/ReadText.h"

namespace {

TEST(FirstLoad, MayHappenOnEveryThreadAtOnce) {
  constexpr int kThreads = 8;
  std::atomic<int> waiting{kThreads};
  std::atomic<int> read{0};
  std::vector<std::thread> threads;
  for (int t = 0; t < kThreads; ++t) {
    threads.emplace_back([&waiting, &read] {
      --waiting;
      while (waiting.load() > 0) {
      }
      for (int i = 0; i < 200; ++i) {
        const auto document =
            kestrel_tests::ReadText("<!DOCTYPE a [<!ENTITY e 'x'>]><a b='1'><c/>&e;&#228;</a>");
        if (MCKestrel_800::AttributeText(document->GetRoot(), u"b") == "1") ++read;
      }
    });
  }
  for (std::thread& thread : threads)
    thread.join();
  EXPECT_EQ(read.load(), kThreads * 200);
}

}  // namespace
