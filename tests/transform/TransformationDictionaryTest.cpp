// Tests of computing all derived fields of a case.

#include "kestrel/transform/TransformationDictionary.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <thread>
#include <vector>

#include "kestrel/dictionary/MissingValueSet.h"
#include "kestrel/predicates/Range.h"
#include "tests/support/AllocationCount.h"
#include "tests/transform/DerivedFields.h"

namespace {

using namespace MCKestrel_800;
using namespace kestrel_test;

constexpr auto kText = ScoreDictVar::STRING_VAR;

/// A case's value of a derived field.
double NumberOf(TransformationDictionary& dictionary, Data& data, const std::string& name) {
  return dictionary.GetValuesForDerivedVars(&data.record, &data.dictionary)->Get(name)->GetDouble();
}

TEST(DerivedRecord, IsNullUntilItIsSetUp) {
  TransformationDictionary dictionary;
  Data data;
  AddDerived(dictionary, NewReference("f", "x"));
  EXPECT_EQ(dictionary.GetValuesForDerivedVars(&data.record, &data.dictionary), nullptr);
  EXPECT_EQ(dictionary.GetVarValue("f"), nullptr);
  dictionary.AddVarCaseValue(dictionary.GetVar("f"), "f", 3.0);
  EXPECT_FALSE(dictionary.IsVarValueComputed(dictionary.GetVar("f")));
  EXPECT_EQ(dictionary.GetVarValue("f"), nullptr);
}

TEST(DerivedRecord, HoldsAnEmptyValueOfEachFieldsType) {
  TransformationDictionary dictionary;
  AddDerived(dictionary, NewReference("number", "x"));
  dictionary.AddDerievedVarName("nobody");
  AddDerived(dictionary, NewField("text", "t", TransExpression::kFieldRef, kText));
  AddDerived(dictionary, NewField("date", "d", TransExpression::kFieldRef, ScoreDictVar::kDATETIME_VAR));
  dictionary.AddDerievedVarName("number");
  dictionary.SetUpDerivedCaseRecord();
  EXPECT_EQ(dictionary.GetVarValue("number")->GetDouble(), kSysmis);
  EXPECT_EQ(dictionary.GetVarValue("number")->GetType(), ScoreValue::kNumeric);
  EXPECT_EQ(dictionary.GetVarValue("text")->GetType(), ScoreValue::kString);
  EXPECT_EQ(dictionary.GetVarValue("text")->GetString(), "");
  const auto* date = dynamic_cast<const DateTimeValue*>(dictionary.GetVarValue("date"));
  ASSERT_NE(date, nullptr);
  EXPECT_EQ(date->GetDouble(), kSysmis);
  EXPECT_EQ(date->GetDateTimeType(), kDateTimeVal);
  EXPECT_EQ(dictionary.GetVarValue("nobody"), nullptr);
  const CaseRecord* const record = dictionary.GetValuesForDerivedVars(nullptr, nullptr);
  ASSERT_NE(record, nullptr);
  EXPECT_EQ(record->Size(), 3u);
  for (const char* name : {"number", "text", "date"})
    EXPECT_EQ(dictionary.GetVar(name)->GetValueIndex(), record->GetIndex(name)) << name;
  dictionary.SetUpDerivedCaseRecord();
  EXPECT_EQ(dictionary.GetValuesForDerivedVars(nullptr, nullptr), record) << "a second time does nothing";
}

TEST(DerivedRecord, TakesValuesThatFit) {
  TransformationDictionary dictionary;
  AddDerived(dictionary, NewReference("number", "x"));
  AddDerived(dictionary, NewField("text", "t", TransExpression::kFieldRef, kText));
  AddDerived(dictionary, NewField("date", "d", TransExpression::kFieldRef, ScoreDictVar::kDATETIME_VAR));
  dictionary.SetUpDerivedCaseRecord();
  const ScoreDictVar* const number = dictionary.GetVar("number");
  EXPECT_FALSE(dictionary.IsVarValueComputed(number));
  dictionary.AddVarCaseValue(number, "number", std::string("text"));
  dictionary.AddVarCaseValue(number, "nobody", 5.0);
  dictionary.AddVarCaseValue(number, "number", nullptr);
  EXPECT_FALSE(dictionary.IsVarValueComputed(number)) << "refused values mark nothing";
  dictionary.AddVarCaseValue(nullptr, "number", 4.0);
  EXPECT_FALSE(dictionary.IsVarValueComputed(number));
  EXPECT_EQ(dictionary.GetVarValue("number")->GetDouble(), 4);
  dictionary.AddVarCaseValue(number, "number", 5.0);
  EXPECT_TRUE(dictionary.IsVarValueComputed(number));
  EXPECT_EQ(dictionary.GetVarValue("number")->GetDouble(), 5);
  const NumericValue six(6);
  dictionary.AddVarCaseValue(number, "number", &six);
  EXPECT_EQ(dictionary.GetVarValue("number")->GetDouble(), 6);
  const StringValue text("abc");
  dictionary.AddVarCaseValue(dictionary.GetVar("text"), "text", &text);
  EXPECT_EQ(dictionary.GetVarValue("text")->GetString(), "abc");
  dictionary.AddVarCaseValue(dictionary.GetVar("date"), "date", 86400.0, kDateVal);
  EXPECT_EQ(dictionary.GetVarValue("date")->GetString(), "1970-01-02");
  const DateTimeValue date(3600.0, kTimeVal);
  dictionary.AddVarCaseValue(dictionary.GetVar("date"), "date", &date);
  EXPECT_EQ(dictionary.GetVarValue("date")->GetString(), "01:00:00");
  dictionary.AddVarCaseValue(number, "number", 1.0, kDateVal);
  EXPECT_EQ(dictionary.GetVarValue("number")->GetDouble(), 6) << "a date/time is no number";
}

TEST(DerivedValues, FollowTheFieldsThatTheyReadInAnyOrder) {
  Data data;
  TransformationDictionary dictionary;
  AddDerived(dictionary, NewApply("c", Call(kPlusFunction, {FieldLeaf("b"), FieldLeaf("b")})));
  AddDerived(dictionary, NewReference("b", "a"));
  AddDerived(dictionary, NewApply("a", Call(kMultiplyFunction, {FieldLeaf("x"), ConstantLeaf(Number(10))})));
  dictionary.SetUpDerivedCaseRecord();
  for (const double x : {1.0, 2.0, 1.0}) {
    data.record.SetValue("x", x);
    EXPECT_EQ(NumberOf(dictionary, data, "c"), 20 * x);
    EXPECT_EQ(dictionary.GetVarValue("b")->GetDouble(), 10 * x);
    for (const char* name : {"a", "b", "c"})
      EXPECT_TRUE(dictionary.IsVarValueComputed(dictionary.GetVar(name)));
    auto* const c = static_cast<TransformVar*>(dictionary.GetVar("c"));
    EXPECT_EQ(c->GetTransformedValue(&data.record, &data.dictionary, &dictionary)->GetDouble(), 20 * x);
  }
  data.record.SetMissingValue("x");
  EXPECT_EQ(NumberOf(dictionary, data, "c"), kSysmis) << "no value of the case before is left";
}

TEST(DerivedValues, OfTheCaseItselfGoFirst) {
  Data data;
  TransformationDictionary dictionary;
  AddDerived(dictionary, NewReference("a", "x"));
  AddDerived(dictionary, NewReference("b", "a"));
  dictionary.SetUpDerivedCaseRecord();
  data.record.SetValue("x", 1);
  EXPECT_EQ(NumberOf(dictionary, data, "b"), 1);
  data.record.Add("a", Number(7));
  EXPECT_EQ(NumberOf(dictionary, data, "b"), 7);
  EXPECT_EQ(dictionary.GetVarValue("a")->GetDouble(), 1);
  data.record.Remove("a");
  EXPECT_EQ(NumberOf(dictionary, data, "b"), 1) << "an empty slot is no value";
}

TEST(DerivedValues, MissWhatDependsOnItselfAndNothingElse) {
  Data data;
  TransformationDictionary dictionary;
  const auto plus_one_if_there = [](const char* name) {
    return Call(kSumFunction, {FieldLeaf(name), ConstantLeaf(Number(1))});
  };
  AddDerived(dictionary, NewApply("self", plus_one_if_there("self")));
  AddDerived(dictionary, NewApply("ring1", plus_one_if_there("ring2")));
  AddDerived(dictionary, NewApply("ring2", plus_one_if_there("ring3")));
  AddDerived(dictionary, NewApply("ring3", plus_one_if_there("ring1")));
  AddDerived(dictionary, NewApply("between", plus_one_if_there("ring1")));
  AddDerived(dictionary, NewApply("ring4", Call(kSumFunction, {FieldLeaf("ring5"), FieldLeaf("between")})));
  AddDerived(dictionary, NewReference("ring5", "ring4"));
  dictionary.SetUpDerivedCaseRecord();
  for (int time = 0; time < 2; ++time) {
    for (const char* name : {"self", "ring1", "ring2", "ring3", "ring4", "ring5"}) {
      EXPECT_EQ(NumberOf(dictionary, data, name), kSysmis) << name;
      auto* const field = static_cast<TransformVar*>(dictionary.GetVar(name));
      EXPECT_EQ(field->GetTransformedValue(&data.record, &data.dictionary, &dictionary)->GetDouble(),
                kSysmis);
    }
    EXPECT_EQ(NumberOf(dictionary, data, "between"), 1) << "it reads a ring and is in none";
  }
}

TEST(DerivedValues, OfLongChainsAndDoublingsCostWhatTheirNumberSays) {
  Data data;
  data.record.SetValue("x", 1);
  constexpr int kLength = 5000;
  for (const bool is_backwards : {false, true}) {
    TransformationDictionary dictionary;
    for (int i = 0; i < kLength; ++i) {
      const int number = is_backwards ? kLength - 1 - i : i;
      const std::string before = number == 0 ? "x" : "f" + std::to_string(number - 1);
      // Twice each: 2 to the 5,000th ways.
      AddDerived(dictionary, NewApply("f" + std::to_string(number),
                                      Call(kMinFunction, {FieldLeaf(before), FieldLeaf(before)})));
    }
    dictionary.SetUpDerivedCaseRecord();
    const std::string last = "f" + std::to_string(kLength - 1);
    EXPECT_EQ(NumberOf(dictionary, data, last), 1);
    auto* const field = static_cast<TransformVar*>(dictionary.GetVar(last));
    EXPECT_EQ(field->GetTransformedValue(&data.record, &data.dictionary, &dictionary)->GetDouble(), 1);
    const std::unique_ptr<TransformationDictionary> clone(dictionary.Clone());
    EXPECT_EQ(NumberOf(*clone, data, last), 1);
  }
}

TEST(DerivedValues, OfTreesThatAreTooDeepAreMissing) {
  Data data;
  data.record.SetValue("x", 1);
  for (const int depth : {510, 100'000}) {
    FunctionTree* tree = FieldLeaf("x");
    for (int i = 0; i < depth; ++i)
      tree = Call(kAbsFunction, {tree});
    TransformationDictionary dictionary;
    AddDerived(dictionary, NewApply("f", tree));
    dictionary.SetUpDerivedCaseRecord();
    EXPECT_EQ(NumberOf(dictionary, data, "f"), depth == 510 ? 1 : kSysmis);
  }
}

TEST(DerivedValues, OfIfAreWhatItsChosenArgumentIs) {
  Data data;
  data.record.SetValue("t", "text");
  data.record.SetValue("d", 1.0, kDateDaysSince1970);
  TransformationDictionary dictionary;
  const auto choose = [](const char* second, FunctionTree* third) {
    return Call(kIfFunction, {FieldLeaf("x"), FieldLeaf(second), third});
  };
  AddDerived(dictionary, NewApply("text or number", choose("t", ConstantLeaf(Number(5)))));
  AddDerived(dictionary, NewApply("date or number", choose("d", ConstantLeaf(Number(5)))));
  AddDerived(dictionary,
             NewApply("year", Call(kYearFromDateFunction, {choose("d", ConstantLeaf(Number(5)))})));
  AddDerived(dictionary, NewApply("absent", Call(kIfFunction, {FieldLeaf("x"), ConstantLeaf(Number(3))})));
  AddDerived(dictionary, NewApply("number or text", choose("y", FieldLeaf("t")), kText));
  TransformVar* const empty_map = NewField("empty map", "t", TransExpression::kMapValues);
  empty_map->SetRecodeDefaultValue(Number(9));
  AddDerived(dictionary, empty_map);
  dictionary.SetUpDerivedCaseRecord();
  data.record.SetValue("x", 1);
  EXPECT_EQ(NumberOf(dictionary, data, "text or number"), kSysmis);
  EXPECT_EQ(NumberOf(dictionary, data, "date or number"), 86400);
  EXPECT_EQ(NumberOf(dictionary, data, "year"), 1970);
  EXPECT_EQ(NumberOf(dictionary, data, "absent"), 3);
  EXPECT_EQ(dictionary.GetVarValue("number or text")->GetString(), "");
  EXPECT_EQ(NumberOf(dictionary, data, "empty map"), 9);
  data.record.SetValue("x", 0);
  EXPECT_EQ(NumberOf(dictionary, data, "text or number"), 5);
  EXPECT_EQ(NumberOf(dictionary, data, "date or number"), 5);
  EXPECT_EQ(NumberOf(dictionary, data, "year"), kSysmis) << "a number is no date";
  EXPECT_EQ(NumberOf(dictionary, data, "absent"), kSysmis);
  EXPECT_EQ(dictionary.GetVarValue("number or text")->GetString(), "text");
}

TEST(DerivedValues, AreComputedWhereTheyAreWanted) {
  Data data;
  data.record.SetValue("x", 1);
  TransformationDictionary dictionary;
  AddDerived(dictionary, NewReference("a", "x"));
  AddDerived(dictionary, NewReference("b", "a"));
  AddDerived(dictionary, NewReference("c", "x"));
  dictionary.SetUpDerivedCaseRecord();
  EXPECT_EQ(NumberOf(dictionary, data, "c"), 1);
  dictionary.SetWantedVars({"b", "nobody"});
  EXPECT_EQ(NumberOf(dictionary, data, "b"), 1);
  EXPECT_EQ(NumberOf(dictionary, data, "c"), kSysmis) << "the value of the case before is gone";
  EXPECT_FALSE(dictionary.IsVarValueComputed(dictionary.GetVar("c")));
  EXPECT_FALSE(dictionary.IsVarValueComputed(dictionary.GetVar("a")));
  EXPECT_TRUE(dictionary.IsVarValueComputed(dictionary.GetVar("b")));
  TransformationDictionary copy(dictionary);
  EXPECT_EQ(NumberOf(copy, data, "c"), kSysmis);
  dictionary.SetWantedVars(dictionary.GetDerivedVarNames());
  EXPECT_EQ(NumberOf(dictionary, data, "c"), 1);
}

TEST(DerivedValues, SeeFieldsThatAreAddedAndRemoved) {
  Data data;
  data.record.SetValue("x", 1);
  TransformationDictionary dictionary;
  AddDerived(dictionary, NewReference("a", "b"));
  dictionary.SetUpDerivedCaseRecord();
  EXPECT_EQ(NumberOf(dictionary, data, "a"), kSysmis);
  dictionary.AddVar("b", NewReference("b", "x"));
  EXPECT_EQ(NumberOf(dictionary, data, "a"), 1);
  dictionary.RemoveVar("b");
  EXPECT_EQ(NumberOf(dictionary, data, "a"), kSysmis);
  static_cast<TransformVar*>(dictionary.GetVar("a"))
      ->AddFieldNameAndTransExpression("x", TransExpression::kFieldRef);
  EXPECT_EQ(NumberOf(dictionary, data, "a"), 1);
}

/// A host's own record: it promises nothing about its layout.
class PlainRecord : public CaseRecord {
 public:
  unsigned long long GetLayoutStamp() const override { return 0; }
};

TEST(DerivedValues, ComeFromRecordsWithoutStamp) {
  Data data;
  TransformationDictionary dictionary;
  AddDerived(dictionary, NewReference("a", "x"));
  dictionary.SetUpDerivedCaseRecord();
  for (const bool x_first : {true, false}) {
    PlainRecord record;
    record.Add(x_first ? "x" : "y", Number(1));
    record.Add(x_first ? "y" : "x", Number(2));
    const CaseRecord* const derived = dictionary.GetValuesForDerivedVars(&record, &data.dictionary);
    EXPECT_EQ(derived->Get("a")->GetDouble(), x_first ? 1 : 2);
  }
}

TEST(DerivedValues, KnowMissingValuesOfDerivedFields) {
  Data data;
  TransformationDictionary dictionary;
  TransformVar* const a = NewReference("a", "x");
  a->SetMissingValues(new MissingValueSet);
  a->GetMissingValues()->Add(new Range(Number(9)));
  AddDerived(dictionary, a);
  TransformVar* const b = NewReference("b", "a");
  b->SetRecodeMissValueTo(Number(-1));
  AddDerived(dictionary, b);
  dictionary.SetUpDerivedCaseRecord();
  data.record.SetValue("x", 9);
  EXPECT_EQ(NumberOf(dictionary, data, "b"), -1);
  data.record.SetValue("x", 8);
  EXPECT_EQ(NumberOf(dictionary, data, "b"), 8);
}

/// One of each, with results of every type.
void AddOneOfEach(TransformationDictionary& dictionary) {
  TransformVar* const norm = NewField("norm", "x", TransExpression::kNormContinuous);
  norm->AddLinearNorm(0, 0);
  norm->AddLinearNorm(1, 10);
  norm->AddNormInfo(10, 0);
  AddDerived(dictionary, norm);
  TransformVar* const map = NewField("map", "t", TransExpression::kMapValues, kText);
  map->AddEncodingMap(Is(Text("a")), Text("alpha"));
  map->AddEncodingMap(Is(Text("b")), Text("beta"));
  map->SetRecodeElseCopy(true);
  map->SetWidth(4);
  AddDerived(dictionary, map);
  TransformVar* const bin = NewField("bin", "y", TransExpression::kDiscretize, kText);
  bin->AddBinningValue(new Range(0, 1, true, false), Text("low"));
  bin->SetRecodeDefaultValue(Text("high"));
  AddDerived(dictionary, bin);
  AddDerived(dictionary, NewField("day", "d", TransExpression::kFieldRef, ScoreDictVar::kDATETIME_VAR));
  AddDerived(dictionary, NewApply("sum", Call(kSumFunction, {FieldLeaf("x"), FieldLeaf("norm")})));
  AddDerived(dictionary, NewApply("median", Call(kMedianFunction,
                                                 {FieldLeaf("x"), FieldLeaf("y"), ConstantLeaf(Number(3))})));
  AddDerived(dictionary,
             NewApply("text", Call(kConcatFunction, {FieldLeaf("map"), FieldLeaf("bin")}), kText));
  AddDerived(dictionary, NewApply("upper", Call(kUppercaseFunction, {FieldLeaf("text")}), kText));
  dictionary.SetUpDerivedCaseRecord();
}

void FillCase(Data& data, int number) {
  data.record.SetValue("x", number % 7 * 0.25);
  data.record.SetValue("y", number % 5 * 0.5);
  data.record.SetValue("t", number % 3 == 0 ? "a" : number % 3 == 1 ? "b" : "other");
  data.record.SetValue("d", static_cast<double>(number), kDateDaysSince1970);
  if (number % 11 == 0) data.record.SetMissingValue("x");
}

std::string Values(TransformationDictionary& dictionary, Data& data) {
  std::string text;
  for (const ScoreValue* value :
       dictionary.GetValuesForDerivedVars(&data.record, &data.dictionary)->GetAllValues())
    text += value->GetString() + ";";
  return text;
}

TEST(DerivedValues, AreTheSameInACloneOnEachThread) {
  TransformationDictionary dictionary;
  AddOneOfEach(dictionary);
  constexpr int kCases = 500;
  std::vector<std::string> wanted;
  Data data;
  for (int i = 0; i < kCases; ++i) {
    FillCase(data, i);
    wanted.push_back(Values(dictionary, data));
  }
  EXPECT_EQ(wanted[1], "2.5;beta;low;1970-01-02;2.75;0.5;betalow;BETALOW;");
  const auto compute = [&wanted](std::unique_ptr<TransformationDictionary> clone, int* wrong) {
    Data own_data;
    for (int i = kCases - 1; i >= 0; --i) {
      FillCase(own_data, i);
      if (Values(*clone, own_data) != wanted[static_cast<std::size_t>(i)]) ++*wrong;
    }
  };
  int wrong[] = {0, 0};
  std::thread first(compute, std::unique_ptr<TransformationDictionary>(dictionary.Clone()), &wrong[0]);
  std::thread second(compute, std::unique_ptr<TransformationDictionary>(dictionary.Clone()), &wrong[1]);
  first.join();
  second.join();
  EXPECT_EQ(wrong[0] + wrong[1], 0);
}

TEST(DerivedValues, AllocateNothingAfterTheFirstCases) {
  TransformationDictionary dictionary;
  AddOneOfEach(dictionary);
  Data data;
  std::vector<TransformVar*> fields;
  for (ScoreDictVar* variable : dictionary.GetScoreDictVars())
    fields.push_back(static_cast<TransformVar*>(variable));
  const auto compute = [&] {
    for (int i = 0; i < 100; ++i) {
      FillCase(data, i);
      ASSERT_NE(dictionary.GetValuesForDerivedVars(&data.record, &data.dictionary), nullptr);
      for (TransformVar* field : fields)
        field->GetTransformedValue(&data.record, &data.dictionary, &dictionary);
    }
  };
  compute();
  const size_t before = kestrel_tests::CountAllocations();
  compute();
  EXPECT_EQ(kestrel_tests::CountAllocations(), before);
}

}  // namespace
