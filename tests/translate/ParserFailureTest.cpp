// The parser library that cannot be initialised. A program of its own, since the library has one start per
// process.

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>
#include <xercesc/framework/MemoryManager.hpp>
#include <xercesc/util/OutOfMemoryException.hpp>

#include "kestrel/translate/ParserPlatform.h"
#include "tests/support/ExpectFault.h"
#include "tests/support/ReadText.h"

namespace {

using kestrel_tests::ExpectFault;
using kestrel_tests::ReadText;
using MCKestrel_800::RequireParser;

// Has no memory after `granted` requests. What it gave stays with the half-started library for the rest of
// the process.
class FailingMemory final : public xercesc::MemoryManager {
 public:
  explicit FailingMemory(size_t granted) : left_(granted) {}
  void* allocate(XMLSize_t size) override {
    if (left_ == 0) throw xercesc::OutOfMemoryException();
    --left_;
    return std::malloc(size);
  }
  void deallocate(void* p) override { std::free(p); }
  xercesc::MemoryManager* getExceptionMemoryManager() override { return this; }

 private:
  size_t left_;
};

TEST(ParserFailure, IsRememberedAndRefusesEveryLoad) {
  static FailingMemory* const memory = new FailingMemory(100);
  std::string first;
  try {
    RequireParser(memory);
    FAIL() << "nothing was thrown";
  } catch (const MCKestrel_800::KestrelException& fault) {
    EXPECT_EQ(fault.GetErrorCode(), 5);
    first = fault.GetErrorMessage();
    EXPECT_FALSE(first.empty());
  }
  ExpectFault([] { RequireParser(); }, 5, first, "and again");
  ExpectFault([] { ReadText("<a/>"); }, 5, first, "a load");
  ExpectFault([] { ReadText(""); }, 5, first, "a load of nothing");
}

}  // namespace
