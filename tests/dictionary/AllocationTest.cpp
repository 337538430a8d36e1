// What is done for each case must not touch the heap.

#include <gtest/gtest.h>

#include <string>

#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/MissingValueSet.h"
#include "kestrel/dictionary/ScoreBinningEncoder.h"
#include "kestrel/dictionary/ScoreCatNumericEncoder.h"
#include "kestrel/dictionary/ScoreCatStringEncoder.h"
#include "tests/dictionary/TestValues.h"
#include "tests/support/AllocationCount.h"

namespace MCKestrel_800 {
namespace {

/// How often the heap was asked while the function ran.
template <class Function>
size_t AllocationsIn(const Function& function) {
  const size_t before = kestrel_tests::CountAllocations();
  function();
  return kestrel_tests::CountAllocations() - before;
}

// Longer than what a string keeps without the heap.
const std::string kLong(100, 'x');
const std::string kShorter(80, 'y');

TEST(Allocations, TheCounterCounts) {
  EXPECT_EQ(AllocationsIn([] { delete NewNumber(1); }), 1u);
}

TEST(Allocations, FillingAndReadingOccupiedSlotsMakesNone) {
  CaseRecord record;
  record.Add("number", NewNumber(1));
  record.Add("text", NewText(kLong));
  record.Add("date", NewDate(1));
  EXPECT_EQ(AllocationsIn([&] {
              for (int i = 0; i < 100; ++i) {
                record.SetValue(0, 1.0 * i);
                record.SetValue(1, i % 2 == 0 ? kShorter : kLong);
                record.SetValue(2, 1.0 * i, kDateDaysSince1970);
                record.Get(0);
                record.GetLayoutStamp();
                record.SetMissingValue(0);
                record.SetMissingValue(1);
                record.SetMissingValue(2);
              }
            }),
            0u);
}

TEST(Allocations, EncodingKnownAndUnknownValuesMakesNone) {
  ScoreCatStringEncoder texts(std::vector<std::string>{kLong, "a"});
  ScoreCatNumericEncoder numbers(std::vector<double>{1, 2});
  ScoreBinningEncoder bins(std::vector<double>{1, 2});
  const StringValue known(kLong + "  ");
  const StringValue unknown(kShorter + " ");
  const NumericValue number(2);
  EXPECT_EQ(AllocationsIn([&] {
              texts.EncodeConst(&known);
              texts.EncodeConst(&unknown);
              numbers.EncodeConst(&number);
              bins.EncodeConst(&number);
            }),
            0u);
  EXPECT_EQ(texts.EncodeConst(&known), 0);
  EXPECT_EQ(texts.EncodeConst(&unknown), -1);
}

TEST(Allocations, AskingForMissingAndValidValuesMakesNone) {
  for (const int count : {3, 100}) {
    DictVar numbers("n", ScoreDictVar::kNUMERIC_VAR);
    DictVar texts("t", ScoreDictVar::STRING_VAR);
    auto* missing = new MissingValueSet;
    numbers.SetMissingValues(missing);
    texts.SetMissingValues(missing->Clone());
    for (DictVar* var : {&numbers, &texts})
      var->SetMLevel(ScoreDictVar::kNominal);
    for (int i = 0; i < count; ++i) {
      numbers.AddScoreValueLabel(NewNumber(i), "label");
      texts.AddScoreValueLabel(NewText(kLong + std::to_string(i)), "label");
      missing->Add(NewSingle(-i));
      texts.GetMissingValues()->Add(NewSingle(kShorter + std::to_string(i)));
    }
    const NumericValue number(1);
    const NumericValue absent(-1);
    const StringValue text(kLong + "1 ");
    const StringValue absentText(kShorter + "1");
    EXPECT_EQ(AllocationsIn([&] {
                for (const ScoreValue* value : std::initializer_list<const ScoreValue*>{&number, &absent}) {
                  numbers.IsMissingValue(value);
                  numbers.IsValidValue(value);
                }
                for (const ScoreValue* value : std::initializer_list<const ScoreValue*>{&text, &absentText}) {
                  texts.IsMissingValue(value);
                  texts.IsValidValue(value);
                }
              }),
              0u);
    EXPECT_TRUE(numbers.IsValidValue(&number));
    EXPECT_TRUE(numbers.IsMissingValue(&absent));
    EXPECT_TRUE(texts.IsValidValue(&text));
    EXPECT_TRUE(texts.IsMissingValue(&absentText));
  }
}

}  // namespace
}  // namespace MCKestrel_800
