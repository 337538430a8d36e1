#include "kestrel/dictionary/CaseRecord.h"

#include <gtest/gtest.h>

#include <limits>
#include <memory>
#include <new>
#include <set>
#include <thread>

#include "kestrel/dictionary/DictVar.h"
#include "tests/dictionary/TestValues.h"

namespace MCKestrel_800 {
namespace {

using Names = std::vector<std::string>;

TEST(CaseRecord, StartsWithoutSlots) {
  for (const int n : {5, 0, -1, std::numeric_limits<int>::min(), std::numeric_limits<int>::max()}) {
    const CaseRecord record(n);
    EXPECT_EQ(record.Size(), 0u) << n;
    EXPECT_EQ(record.Get(0), nullptr) << n;
    EXPECT_TRUE(record.GetVarNames().empty()) << n;
  }
}

TEST(CaseRecord, PositionsFollowTheOrderOfArrivalAndNamesAreSorted) {
  CaseRecord record;
  NumericValue* valueOfB = NewNumber(1);
  const std::unique_ptr<NumericValue> replaced(NewNumber(2));
  record.Add("b", valueOfB);
  record.Add("a", replaced.get());
  EXPECT_EQ(record.GetIndex("b"), 0);
  EXPECT_EQ(record.GetIndex("a"), 1);
  EXPECT_EQ(record.GetIndex("A"), -1);
  EXPECT_EQ(record.GetVarNames(), (Names{"a", "b"}));
  EXPECT_EQ(record.Get("b"), valueOfB);
  EXPECT_EQ(record.Get(1), replaced.get());
  // The value that was there is the caller's again: it is freed by this test, not by the record.
  NumericValue* third = NewNumber(3);
  record.Add("a", third);
  EXPECT_EQ(record.Size(), 2u);
  EXPECT_EQ(record.Get("a"), third);
  EXPECT_EQ(record.GetAllValues(), (std::vector<ScoreValue*>{valueOfB, third}));
}

TEST(CaseRecord, AnswersNullOutsideItsSlots) {
  CaseRecord record;
  record.Add("a", NewNumber(1));
  for (const int index : {-1, 1, std::numeric_limits<int>::min(), std::numeric_limits<int>::max()}) {
    EXPECT_EQ(record.Get(index), nullptr) << index;
    EXPECT_FALSE(record.SetValue(index, 1.0)) << index;
    EXPECT_FALSE(record.SetValue(index, "x")) << index;
    EXPECT_FALSE(record.SetValue(index, 1.0, kDate)) << index;
    EXPECT_FALSE(record.SetMissingValue(index)) << index;
  }
  EXPECT_EQ(record.Get("b"), nullptr);
  EXPECT_FALSE(record.SetValue("b", 1.0));
  EXPECT_FALSE(record.SetValue("b", "x"));
  EXPECT_FALSE(record.SetValue("b", 1.0, kDate));
  EXPECT_FALSE(record.SetMissingValue("b"));
}

TEST(CaseRecord, ASlotTakesItsOwnKindAlone) {
  struct Row {
    const char* name;
    std::shared_ptr<ScoreValue> value;  // null: an empty slot
    bool number;
    bool text;
    bool date;
  };
  const Row rows[] = {
      {"empty", nullptr, true, true, true},
      {"number", std::make_shared<NumericValue>(1), true, false, false},
      {"text", std::make_shared<StringValue>("a"), false, true, false},
      {"date", std::make_shared<DateTimeValue>(5.0, kTimeVal), false, false, true},
      {"foreign number", std::make_shared<WholeValue>(1, ScoreValue::kNumeric), true, false, false},
      {"foreign text", std::make_shared<WholeValue>(1, ScoreValue::kString), false, true, false},
      {"foreign date", std::make_shared<WholeValue>(1, ScoreValue::kDateTime), false, false, true},
  };
  for (const Row& row : rows) {
    const auto record = [&] {
      auto made = std::make_unique<CaseRecord>();
      made->Add("x", row.value ? row.value->Clone() : nullptr);
      return made;
    };
    const auto numbers = record();
    EXPECT_EQ(numbers->SetValue(0, 2.5), row.number) << row.name;
    EXPECT_EQ(numbers->SetValue("x", 3.5), row.number) << row.name;
    if (row.number) {
      EXPECT_EQ(numbers->Get(0)->GetDouble(), 3.5) << row.name;
    }
    const auto texts = record();
    EXPECT_EQ(texts->SetValue(0, "7"), row.text) << row.name;
    EXPECT_EQ(texts->SetValue("x", "8"), row.text) << row.name;
    if (row.text) {
      EXPECT_EQ(texts->Get(0)->GetDouble(), 8) << row.name;
    }
    const auto dates = record();
    EXPECT_EQ(dates->SetValue(0, 1.0, kDateDaysSince1970), row.date) << row.name;
    if (row.date) {
      EXPECT_EQ(dates->Get(0)->GetDouble(), 86400) << row.name;
    }
    EXPECT_EQ(dates->SetValue("x", 2.0, kDateDaysSince1970), row.date) << row.name;
    if (row.date) {
      EXPECT_EQ(dates->Get(0)->GetDouble(), 2 * 86400) << row.name;
    }
    for (const auto* used : {&numbers, &texts, &dates}) {
      const ScoreValue* held = (*used)->Get(0);
      if (!row.value || held == nullptr) continue;
      EXPECT_EQ(held->GetType(), row.value->GetType()) << row.name;
    }
    if (!row.number && row.value) {
      EXPECT_TRUE(*numbers->Get(0) == *row.value) << row.name;
    }
    if (!row.text && row.value) {
      EXPECT_TRUE(*texts->Get(0) == *row.value) << row.name;
    }
    if (!row.date && row.value) {
      EXPECT_TRUE(*dates->Get(0) == *row.value) << row.name;
    }
  }
}

TEST(CaseRecord, AnEmptySlotGetsANewValueOfTheKindThatIsWritten) {
  CaseRecord record;
  for (const char* name : {"number", "text", "date"})
    record.Add(name, nullptr);
  EXPECT_TRUE(record.SetValue("number", 2.5));
  EXPECT_TRUE(record.SetValue("text", "x"));
  EXPECT_TRUE(record.SetValue("date", 1.0, kTimeSeconds));
  EXPECT_EQ(record.Get(0)->GetType(), ScoreValue::kNumeric);
  EXPECT_EQ(record.Get(1)->GetType(), ScoreValue::kString);
  EXPECT_EQ(record.Get(2)->GetString(), "00:00:01");
}

TEST(CaseRecord, SetMissingValueFollowsTheKind) {
  CaseRecord record;
  record.Add("number", NewNumber(1));
  record.Add("date", new DateTimeValue(5.0, kTimeVal));
  record.Add("text", NewText("abc"));
  record.Add("foreign number", new WholeValue(1, ScoreValue::kNumeric));
  record.Add("foreign date", new WholeValue(1, ScoreValue::kDateTime));
  record.Add("foreign text", new WholeValue(1, ScoreValue::kString));
  record.Add("empty", nullptr);
  for (const char* name : {"number", "date", "foreign number", "foreign date"}) {
    EXPECT_TRUE(record.SetMissingValue(name)) << name;
    EXPECT_TRUE(record.Get(name)->IsSystemMissingValue()) << name;
  }
  EXPECT_EQ(static_cast<const DateTimeValue*>(record.Get("date"))->GetDateTimeType(), kTimeVal);
  EXPECT_TRUE(record.SetMissingValue(2));
  EXPECT_EQ(record.Get(2)->GetString(), "");
  EXPECT_TRUE(record.SetMissingValue("foreign text"));
  EXPECT_EQ(record.Get("foreign text")->GetDouble(), 0);
  EXPECT_FALSE(record.SetMissingValue("empty"));
  EXPECT_TRUE(record.SetMissingValue(0));
  EXPECT_TRUE(record.SetValue(0, 4.0));
  EXPECT_EQ(record.Get(0)->GetDouble(), 4);
}

/// A date of a class derived from ours.
class NamedDate : public DateTimeValue {
 public:
  using DateTimeValue::DateTimeValue;
};

TEST(CaseRecord, AMissingDateStaysOfItsKindAlsoInADerivedClass) {
  CaseRecord record;
  auto* date = new NamedDate(5.0, kTimeVal);
  record.Add("date", date);
  EXPECT_TRUE(record.SetMissingValue("date"));
  EXPECT_TRUE(date->IsSystemMissingValue());
  EXPECT_EQ(date->GetDateTimeType(), kTimeVal);
}

/// A value that cannot be copied.
class Uncopyable : public WholeValue {
 public:
  using WholeValue::WholeValue;
  ScoreValue* Clone() const override { throw std::bad_alloc(); }
};

TEST(CaseRecord, StaysAsItWasWhenAnotherCannotBeCopied) {
  CaseRecord record, other;
  record.Add("kept", NewNumber(1));
  other.Add("a", NewNumber(2));
  other.Add("b", new Uncopyable(3));
  const unsigned long long stamp = record.GetLayoutStamp();
  EXPECT_THROW(record = other, std::bad_alloc);
  EXPECT_EQ(record.GetVarNames(), Names{"kept"});
  EXPECT_EQ(record.Get("kept")->GetDouble(), 1);
  EXPECT_EQ(record.GetLayoutStamp(), stamp);
  EXPECT_THROW(CaseRecord copy(other), std::bad_alloc);
}

TEST(CaseRecord, RemoveEmptiesTheSlotAndKeepsTheName) {
  CaseRecord record;
  record.Add("b", NewText("x"));
  record.Add("a", NewNumber(1));
  record.Remove("unknown");
  record.Remove("a");
  record.Remove("a");
  EXPECT_EQ(record.GetIndex("a"), 1);
  EXPECT_EQ(record.Get("a"), nullptr);
  EXPECT_EQ(record.Size(), 2u);
  EXPECT_FALSE(record.SetMissingValue("a"));
  EXPECT_TRUE(record.SetValue("a", 2.5));
  EXPECT_EQ(record.Get(1)->GetDouble(), 2.5);
  record.Remove("b");
  EXPECT_TRUE(record.SetValue("b", 1.5));
}

TEST(CaseRecord, SetUpNameIndexMapOnlyReserves) {
  CaseRecord record;
  DictVar var("a", ScoreDictVar::kNUMERIC_VAR);
  record.SetUpNameIndexMap(Names{"a", "b"});
  record.SetUpNameIndexMap(std::vector<ScoreDictVar*>{&var});
  EXPECT_EQ(record.Size(), 0u);
  EXPECT_EQ(record.GetIndex("a"), -1);
  EXPECT_TRUE(record.HasMap());
}

TEST(CaseRecord, CopiesAreDeep) {
  CaseRecord record;
  record.Add("number", NewNumber(1));
  record.Add("empty", nullptr);
  record.Add("text", NewText("x"));
  const CaseRecord copy(record);
  CaseRecord assigned;
  assigned.Add("old", NewNumber(9));
  assigned = record;
  const CaseRecord& same = assigned;
  assigned = same;
  record.SetValue("number", 2.0);
  record.SetValue("text", "y");
  for (const CaseRecord* other : std::vector<const CaseRecord*>{&copy, &assigned}) {
    EXPECT_EQ(other->GetVarNames(), (Names{"empty", "number", "text"}));
    EXPECT_EQ(other->Get("number")->GetDouble(), 1);
    EXPECT_EQ(other->Get("text")->GetString(), "x");
    EXPECT_EQ(other->Get("empty"), nullptr);
    EXPECT_EQ(other->GetIndex("text"), 2);
    EXPECT_EQ(other->GetIndex("old"), -1);
  }
  EXPECT_TRUE(assigned.SetValue(0, 5.0));
  EXPECT_EQ(assigned.Get(0)->GetDouble(), 5);
}

TEST(CaseRecord, StampChangesWithTheLayoutAndWithNothingElse) {
  CaseRecord record;
  std::set<unsigned long long> stamps{record.GetLayoutStamp()};
  record.Add("a", NewNumber(1));
  EXPECT_TRUE(stamps.insert(record.GetLayoutStamp()).second);
  record.Add("b", nullptr);
  EXPECT_TRUE(stamps.insert(record.GetLayoutStamp()).second);
  const unsigned long long stamp = record.GetLayoutStamp();
  record.SetValue("a", 2.0);
  record.SetValue("b", "x");
  record.SetMissingValue("a");
  record.Remove("b");
  record.Add("b", NewNumber(3));
  record.SetUpNameIndexMap(Names{"z"});
  EXPECT_EQ(record.GetLayoutStamp(), stamp);
  EXPECT_EQ(stamps.count(0), 0u);
}

TEST(CaseRecord, CopiesShareTheStampUntilOneGetsANewName) {
  CaseRecord record;
  record.Add("a", NewNumber(1));
  CaseRecord copy(record);
  CaseRecord assigned;
  assigned.Add("a", NewNumber(1));
  EXPECT_NE(assigned.GetLayoutStamp(), record.GetLayoutStamp());
  assigned = record;
  EXPECT_EQ(copy.GetLayoutStamp(), record.GetLayoutStamp());
  EXPECT_EQ(assigned.GetLayoutStamp(), record.GetLayoutStamp());
  copy.Add("b", NewNumber(2));
  assigned.Add("c", NewNumber(2));
  EXPECT_NE(copy.GetLayoutStamp(), record.GetLayoutStamp());
  EXPECT_NE(assigned.GetLayoutStamp(), record.GetLayoutStamp());
  EXPECT_NE(assigned.GetLayoutStamp(), copy.GetLayoutStamp());
}

TEST(CaseRecord, StampsOfRecordsMadeOnSeveralThreadsDiffer) {
  constexpr int kThreads = 4;
  constexpr int kRecords = 500;
  std::vector<std::vector<unsigned long long>> drawn(kThreads);
  std::vector<std::thread> threads;
  for (auto& list : drawn) {
    threads.emplace_back([&list] {
      for (int i = 0; i < kRecords; ++i) {
        CaseRecord record;
        record.Add("a", nullptr);
        list.push_back(record.GetLayoutStamp());
      }
    });
  }
  for (std::thread& thread : threads)
    thread.join();
  std::set<unsigned long long> all;
  for (const auto& list : drawn)
    all.insert(list.begin(), list.end());
  EXPECT_EQ(all.size(), static_cast<std::size_t>(kThreads * kRecords));
}

TEST(CaseRecord, DisplaysNamesInOrderWithTheirValues) {
  CaseRecord record;
  EXPECT_EQ(DisplayOf(record), "Start ScoreCaseRecord Display:\nEnd of ScoreCaseRecord Display.\n\n");
  record.Add("c", NewText("x"));
  record.Add("b", nullptr);
  record.Add("a", NewNumber(1.5));
  record.Add("d", NewNumber(NumericValue::gSysmisValue));
  EXPECT_EQ(
      DisplayOf(record),
      "Start ScoreCaseRecord Display:\nVar Name: a; Var Value: 1.5\nVar Name: b\nVar Name: c; Var Value: x\n"
      "Var Name: d; Var Value: Undefined\nEnd of ScoreCaseRecord Display.\n\n");
}

/// An implementation by a host that knows nothing of stamps.
class BareRecord : public CaseRecord {
 public:
  unsigned long long GetLayoutStamp() const override { return ScoreCaseRecord::GetLayoutStamp(); }
};

TEST(ScoreCaseRecord, PromisesNothingByDefault) {
  const BareRecord record;
  EXPECT_EQ(record.GetLayoutStamp(), 0u);
}

}  // namespace
}  // namespace MCKestrel_800
