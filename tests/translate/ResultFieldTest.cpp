// The values of a case's output fields: what is held, who owns it and when its place changes.

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/translate/ResultField.h"
#include "kestrel/translate/ResultVar.h"
#include "tests/support/OperationNumber.h"

namespace {

using namespace MCKestrel_800;
using std::string;
using Names = std::vector<string>;

/// A value that counts how many of its kind there are. What holds one may not write over it as a number.
class CountedValue : public NumericValue {
 public:
  explicit CountedValue(double number) : NumericValue(number) { ++alive; }
  CountedValue(const CountedValue& other) : NumericValue(other) { ++alive; }
  ~CountedValue() override { --alive; }
  ScoreValue* Clone() const override { return new CountedValue(*this); }

  static int alive;
};
int CountedValue::alive = 0;

/// A text of a class that is not the library's own.
class ForeignText : public StringValue {
 public:
  explicit ForeignText(const string& text) : StringValue(text) {}
  ScoreValue* Clone() const override { return new ForeignText(*this); }
};

TEST(ResultField, IsEmptyAtFirst) {
  const ResultField fields;
  EXPECT_EQ(fields.GetResultSize(), 0u);
  EXPECT_EQ(fields.GetResultFields(), Names());
  EXPECT_TRUE(fields.GetMapResultValue().empty());
  EXPECT_EQ(fields.GetResultValue("x"), nullptr);
  EXPECT_EQ(fields.GetLayoutStamp(), 0u);
}

TEST(ResultField, MakesAFieldOfANameThatItDoesNotHave) {
  ResultField fields;
  fields.SetResultValue("risk", 2.5);
  ASSERT_NE(fields.GetResultValue("risk"), nullptr);
  EXPECT_EQ(fields.GetResultValue("risk")->GetType(), ScoreValue::kNumeric);
  EXPECT_EQ(fields.GetResultValue("risk")->GetDouble(), 2.5);

  fields.SetResultValue("class", string("yes"));
  EXPECT_EQ(*fields.GetResultValue("class"), StringValue("yes"));

  const DateTimeValue day(86400.0, kDateVal);
  fields.SetResultValue("day", &day);
  EXPECT_EQ(*fields.GetResultValue("day"), day);
  EXPECT_NE(fields.GetResultValue("day"), &day);

  EXPECT_EQ(fields.GetResultSize(), 3u);
}

TEST(ResultField, GivesItsNamesInTheirOrder) {
  ResultField fields;
  for (const char* name : {"b", "a", "", "B", "aa"})
    fields.SetResultValue(name, 1.0);
  EXPECT_EQ(fields.GetResultFields(), (Names{"", "B", "a", "aa", "b"}));
}

TEST(ResultField, TellsNoTypes) {
  ResultField fields;
  fields.SetResultValue("class", string("yes"));
  EXPECT_EQ(fields.GetResultType("class"), 0);
  EXPECT_EQ(fields.GetResultType("nowhere"), 0);
  EXPECT_EQ(fields.GetResultSize(), 1u);
}

TEST(ResultField, FillsAFieldThatHasNoValue) {
  ResultField fields;
  fields.AddResultField("x", nullptr);
  EXPECT_EQ(fields.GetResultSize(), 1u);
  EXPECT_EQ(fields.GetResultValue("x"), nullptr);
  EXPECT_EQ(fields.GetValueForWriting("x"), nullptr);
  fields.SetResultValue("x", 0.5);
  ASSERT_NE(fields.GetResultValue("x"), nullptr);
  EXPECT_EQ(fields.GetResultValue("x")->GetDouble(), 0.5);
}

TEST(ResultField, LosesItsValueToNull) {
  ResultField fields;
  fields.SetResultValue("x", 0.5);
  fields.SetResultValue("x", static_cast<const ScoreValue*>(nullptr));
  EXPECT_EQ(fields.GetResultValue("x"), nullptr);
  EXPECT_EQ(fields.GetResultFields(), Names{"x"});
  fields.SetResultValue("y", static_cast<const ScoreValue*>(nullptr));
  EXPECT_EQ(fields.GetResultFields(), (Names{"x", "y"}));
}

// ---- In place or not

const NumericValue kOne(1.0);
const NumericValue kTwo(2.0);
const StringValue kYes("yes");
const StringValue kNo("no");
const DateTimeValue kDay(86400.0, kDateVal);
const DateTimeValue kNoon(43200.0, kTimeVal);

struct AssignRow {
  const char* why;
  const ScoreValue* before;
  const ScoreValue* after;
  bool in_place;
};

const AssignRow kAssignments[] = {
    {"a number over a number", &kOne, &kTwo, true},  {"a text over a text", &kYes, &kNo, true},
    {"a moment over a moment", &kDay, &kNoon, true}, {"the same again", &kYes, &kYes, true},
    {"a text over a number", &kOne, &kNo, false},    {"a moment over a number", &kOne, &kDay, false},
    {"a number over a text", &kYes, &kOne, false},   {"a moment over a text", &kYes, &kDay, false},
    {"a number over a moment", &kDay, &kOne, false}, {"a text over a moment", &kDay, &kYes, false},
};

TEST(ResultField, WritesOverAValueOfTheSameKindAlone) {
  for (const AssignRow& row : kAssignments) {
    ResultField fields;
    fields.SetResultValue("x", row.before);
    const ScoreValue* const held = fields.GetResultValue("x");
    const unsigned long long stamp = fields.GetLayoutStamp();
    fields.SetResultValue("x", row.after);
    const ScoreValue* const now = fields.GetResultValue("x");
    ASSERT_NE(now, nullptr) << row.why;
    EXPECT_EQ(*now, *row.after) << row.why;
    EXPECT_EQ(now->GetString(), row.after->GetString()) << row.why;
    EXPECT_EQ(now->GetType(), row.after->GetType()) << row.why;
    EXPECT_EQ(now == held, row.in_place) << row.why;
    EXPECT_EQ(fields.GetLayoutStamp() == stamp, row.in_place) << row.why;
    EXPECT_EQ(fields.GetResultSize(), 1u) << row.why;
  }
}

TEST(ResultField, WritesOverAPlainNumberOrText) {
  ResultField fields;
  fields.SetResultValue("n", 1.0);
  fields.SetResultValue("t", string("long"));
  const ScoreValue* const number = fields.GetResultValue("n");
  const ScoreValue* const text = fields.GetResultValue("t");
  const unsigned long long stamp = fields.GetLayoutStamp();
  fields.SetResultValue("n", -3.0);
  fields.SetResultValue("t", string("a longer text"));
  EXPECT_EQ(fields.GetResultValue("n"), number);
  EXPECT_EQ(fields.GetResultValue("t"), text);
  EXPECT_EQ(number->GetDouble(), -3.0);
  EXPECT_EQ(text->GetString(), "a longer text");
  EXPECT_EQ(static_cast<const StringValue*>(text)->GetLength(), 13);
  EXPECT_EQ(fields.GetLayoutStamp(), stamp);

  fields.SetResultValue("n", string("text"));
  fields.SetResultValue("t", 4.0);
  EXPECT_EQ(*fields.GetResultValue("n"), StringValue("text"));
  EXPECT_EQ(*fields.GetResultValue("t"), NumericValue(4.0));
  EXPECT_NE(fields.GetLayoutStamp(), stamp);
}

TEST(ResultField, CopiesTheLengthOfATextToo) {
  StringValue wide("ab");
  wide.SetLength(20);
  ResultField fields;
  fields.SetResultValue("t", string("abc"));
  fields.SetResultValue("t", &wide);
  EXPECT_EQ(static_cast<const StringValue*>(fields.GetResultValue("t"))->GetLength(), 20);
  fields.SetResultValue("t", string("abc"));
  EXPECT_EQ(static_cast<const StringValue*>(fields.GetResultValue("t"))->GetLength(), 3);
}

TEST(ResultField, TakesItsOwnValues) {
  ResultField fields;
  fields.SetResultValue("a", &kYes);
  fields.SetResultValue("b", &kOne);
  fields.SetResultValue("a", fields.GetResultValue("a"));
  EXPECT_EQ(*fields.GetResultValue("a"), kYes);
  fields.SetResultValue("b", fields.GetResultValue("a"));
  EXPECT_EQ(*fields.GetResultValue("b"), kYes);
  fields.SetResultValue("a", static_cast<const StringValue*>(fields.GetResultValue("a"))->GetText());
  EXPECT_EQ(*fields.GetResultValue("a"), kYes);
}

TEST(ResultField, ClonesValuesOfForeignClasses) {
  {
    ResultField fields;
    const CountedValue value(7.0);
    fields.SetResultValue("x", 1.0);
    fields.SetResultValue("x", &value);
    EXPECT_EQ(CountedValue::alive, 2);
    EXPECT_NE(dynamic_cast<const CountedValue*>(fields.GetResultValue("x")), nullptr);
    fields.SetResultValue("x", &value);
    EXPECT_EQ(CountedValue::alive, 2);
    // Neither is it written over as a plain number: what else it holds would stay.
    fields.SetResultValue("x", 2.0);
    EXPECT_EQ(CountedValue::alive, 1);
    EXPECT_EQ(fields.GetResultValue("x")->GetDouble(), 2.0);
  }
  EXPECT_EQ(CountedValue::alive, 0);
}

// ---- Ownership

TEST(ResultField, OwnsWhatIsAdded) {
  {
    ResultField fields;
    auto* const first = new CountedValue(1.0);
    fields.AddResultField("x", first);
    EXPECT_EQ(fields.GetResultValue("x"), first);
    EXPECT_EQ(fields.GetValueForWriting("x"), first);
    fields.AddResultField("x", first);
    EXPECT_EQ(CountedValue::alive, 1);
    fields.AddResultField("x", new CountedValue(2.0));
    EXPECT_EQ(CountedValue::alive, 1);
    EXPECT_EQ(fields.GetResultValue("x")->GetDouble(), 2.0);
    fields.AddResultField("y", new CountedValue(3.0));
    EXPECT_EQ(CountedValue::alive, 2);
    fields.AddResultField("y", nullptr);
    EXPECT_EQ(CountedValue::alive, 1);
    EXPECT_EQ(fields.GetResultSize(), 2u);
  }
  EXPECT_EQ(CountedValue::alive, 0);
}

TEST(ResultField, TakesAMapInsteadOfItsOwn) {
  {
    ResultField fields;
    auto* const kept = new CountedValue(1.0);
    fields.AddResultField("kept", kept);
    fields.AddResultField("dropped", new CountedValue(2.0));
    fields.SetMapResultValue({{"new", new CountedValue(3.0)}, {"moved", kept}, {"none", nullptr}});
    EXPECT_EQ(CountedValue::alive, 2);
    EXPECT_EQ(fields.GetResultFields(), (Names{"moved", "new", "none"}));
    EXPECT_EQ(fields.GetResultValue("moved"), kept);
    EXPECT_EQ(fields.GetResultValue("none"), nullptr);
    EXPECT_EQ(fields.GetResultValue("kept"), nullptr);

    const unsigned long long stamp = fields.GetLayoutStamp();
    fields.SetMapResultValue(fields.GetMapResultValue());
    EXPECT_EQ(CountedValue::alive, 2);
    EXPECT_EQ(fields.GetResultValue("moved"), kept);
    EXPECT_EQ(fields.GetLayoutStamp(), stamp);

    fields.SetMapResultValue({});
    EXPECT_EQ(CountedValue::alive, 0);
    EXPECT_EQ(fields.GetResultSize(), 0u);
  }
  EXPECT_EQ(CountedValue::alive, 0);
}

TEST(ResultField, CopiesAreDeep) {
  {
    ResultField fields;
    fields.AddResultField("x", new CountedValue(1.0));
    fields.AddResultField("none", nullptr);
    ResultField copy(fields);
    EXPECT_EQ(CountedValue::alive, 2);
    EXPECT_EQ(copy.GetResultFields(), (Names{"none", "x"}));
    EXPECT_NE(copy.GetResultValue("x"), fields.GetResultValue("x"));
    EXPECT_EQ(copy.GetResultValue("none"), nullptr);
    static_cast<NumericValue*>(copy.GetValueForWriting("x"))->SetDoubleValue(9.0);
    EXPECT_EQ(fields.GetResultValue("x")->GetDouble(), 1.0);

    ResultField assigned;
    assigned.AddResultField("old", new CountedValue(5.0));
    assigned = fields;
    EXPECT_EQ(CountedValue::alive, 3);
    EXPECT_EQ(assigned.GetResultFields(), (Names{"none", "x"}));
    EXPECT_EQ(assigned.GetResultValue("x")->GetDouble(), 1.0);

    const ResultField& itself = assigned;
    const ScoreValue* const held = assigned.GetResultValue("x");
    assigned = itself;
    EXPECT_EQ(assigned.GetResultValue("x"), held);
    EXPECT_EQ(CountedValue::alive, 3);
  }
  EXPECT_EQ(CountedValue::alive, 0);
}

// ---- Layout

TEST(ResultField, HasANewLayoutWheneverAPlaceChanges) {
  ResultField fields;
  std::vector<unsigned long long> stamps{fields.GetLayoutStamp()};
  const auto expect_new = [&](const char* why) {
    for (const unsigned long long stamp : stamps)
      EXPECT_NE(fields.GetLayoutStamp(), stamp) << why;
    stamps.push_back(fields.GetLayoutStamp());
  };
  fields.SetResultValue("x", 1.0);
  expect_new("a field by a number");
  fields.SetResultValue("t", string("yes"));
  expect_new("a field by a text");
  fields.SetResultValue("d", &kDay);
  expect_new("a field by a value");
  fields.AddResultField("x", new NumericValue(2.0));
  expect_new("another object");
  fields.AddResultField("none", nullptr);
  expect_new("a field without a value");
  fields.SetResultValue("x", static_cast<const ScoreValue*>(nullptr));
  expect_new("a value less");
  ResultField other;
  other.SetResultValue("x", 1.0);
  fields = other;
  expect_new("another's fields");
  EXPECT_NE(fields.GetLayoutStamp(), other.GetLayoutStamp());
  EXPECT_NE(ResultField(other).GetLayoutStamp(), other.GetLayoutStamp());
  fields.SetMapResultValue({{"x", new NumericValue(1.0)}});
  expect_new("a map");
  fields = ResultField();
  expect_new("no fields any more");
}

TEST(ResultField, KeepsItsLayoutWhenValuesAreWritten) {
  ResultField fields;
  fields.SetResultValue("x", 1.0);
  fields.AddResultField("none", nullptr);
  const unsigned long long stamp = fields.GetLayoutStamp();
  fields.SetResultValue("x", 2.0);
  fields.SetResultValue("x", &kTwo);
  fields.SetResultValue("none", static_cast<const ScoreValue*>(nullptr));
  fields.AddResultField("x", fields.GetValueForWriting("x"));
  fields.ClearValues();
  static_cast<NumericValue*>(fields.GetValueForWriting("x"))->SetDoubleValue(3.0);
  EXPECT_EQ(fields.GetLayoutStamp(), stamp);
  EXPECT_EQ(fields.GetResultValue("x")->GetDouble(), 3.0);
}

TEST(ResultField, HasNoLayoutWhileThereWasNoField) {
  ResultField fields;
  fields.SetMapResultValue({});
  fields = ResultField();
  fields.ClearValues();
  EXPECT_EQ(fields.GetValueForWriting("x"), nullptr);
  EXPECT_EQ(fields.GetLayoutStamp(), 0u);
  EXPECT_EQ(ResultField(fields).GetLayoutStamp(), 0u);
}

TEST(ResultField, MakesAllValuesMissing) {
  ResultField fields;
  fields.SetResultValue("number", 1.0);
  fields.SetResultValue("text", string("yes"));
  fields.SetResultValue("day", &kDay);
  fields.SetResultValue("noon", &kNoon);
  fields.AddResultField("counted", new CountedValue(1.0));
  fields.AddResultField("foreign", new ForeignText("yes"));
  fields.AddResultField("none", nullptr);
  const ScoreResultField::ValueMap before = fields.GetMapResultValue();
  fields.ClearValues();
  EXPECT_EQ(fields.GetMapResultValue(), before);
  for (const char* name : {"number", "day", "noon", "counted"})
    EXPECT_TRUE(fields.GetResultValue(name)->IsSystemMissingValue()) << name;
  for (const char* name : {"text", "foreign"})
    EXPECT_EQ(fields.GetResultValue(name)->GetString(), "") << name;
  EXPECT_EQ(static_cast<const DateTimeValue*>(fields.GetResultValue("day"))->GetDateTimeType(), kDateVal);
  EXPECT_EQ(static_cast<const DateTimeValue*>(fields.GetResultValue("noon"))->GetDateTimeType(), kTimeVal);
  EXPECT_EQ(fields.GetResultValue("none"), nullptr);
}

#if defined(__x86_64__)

TEST(ResultField, KeepsTheOrderOfItsOperations) {
  using kestrel_tests::OperationNumber;
  using Field = ScoreResultField;
  using SetValue = void (Field::*)(const string&, const ScoreValue*);
  using SetText = void (Field::*)(const string&, const string&);
  using SetNumber = void (Field::*)(const string&, double);
  const std::vector<long> numbers = {
      OperationNumber(&Field::SetMapResultValue),
      OperationNumber(&Field::GetMapResultValue),
      OperationNumber(&Field::GetResultValue),
      OperationNumber(static_cast<SetValue>(&Field::SetResultValue)),
      OperationNumber(static_cast<SetText>(&Field::SetResultValue)),
      OperationNumber(static_cast<SetNumber>(&Field::SetResultValue)),
      OperationNumber(&Field::GetResultType),
      OperationNumber(&Field::AddResultField),
      OperationNumber(&Field::GetResultFields),
      OperationNumber(&Field::GetResultSize),
  };
  EXPECT_EQ(numbers, kestrel_tests::InOrder(numbers.size()));
}

#endif

// ---- The variables of the fields

TEST(ResultVar, IsAVariableWithAFeature) {
  ResultVar variable("risk", ScoreDictVar::STRING_VAR);
  EXPECT_EQ(variable.GetName(), "risk");
  EXPECT_EQ(variable.GetVarType(), ScoreDictVar::STRING_VAR);
  EXPECT_EQ(variable.GetFeature(), ScoreResultField::kNoFeature);
  variable.SetFeature(ScoreResultField::kWarning);
  EXPECT_EQ(variable.GetFeature(), ScoreResultField::kWarning);
  EXPECT_FALSE(variable.IsDerivedVariable());
}

TEST(ResultVar, CopiesItsFeatureAndWhatItOwns) {
  ResultVar variable("risk", ScoreDictVar::kNUMERIC_VAR);
  variable.SetFeature(ScoreResultField::kProbability);
  variable.SetDefValue(new StringValue("yes"));
  variable.SetLabel("Risk");

  const ResultVar copy(variable);
  ResultVar assigned("other", ScoreDictVar::STRING_VAR);
  assigned.SetDefValue(new StringValue("no"));
  assigned = variable;
  const ScoreDictVar& base = variable;
  const std::unique_ptr<ScoreDictVar> clone(base.Clone());
  ASSERT_NE(dynamic_cast<const ResultVar*>(clone.get()), nullptr);
  for (const ResultVar* made :
       {&copy, static_cast<const ResultVar*>(&assigned), static_cast<const ResultVar*>(clone.get())}) {
    EXPECT_EQ(made->GetName(), "risk");
    EXPECT_EQ(made->GetLabel(), "Risk");
    EXPECT_EQ(made->GetVarType(), ScoreDictVar::kNUMERIC_VAR);
    EXPECT_EQ(made->GetFeature(), ScoreResultField::kProbability);
    EXPECT_NE(made->GetDefValue(), variable.GetDefValue());
    EXPECT_EQ(*made->GetDefValue(), StringValue("yes"));
  }
}

TEST(ResultVar, StaysOneInACopyOfItsDictionary) {
  BaseDictionary dictionary;
  auto variable = std::make_unique<ResultVar>("risk", ScoreDictVar::kNUMERIC_VAR);
  variable->SetFeature(ScoreResultField::kEntityId);
  dictionary.AddVar("risk", variable.release());
  const std::unique_ptr<ScoreDictionary> copy(dictionary.Clone());
  const auto* const made = dynamic_cast<const ResultVar*>(copy->GetVar("risk"));
  ASSERT_NE(made, nullptr);
  EXPECT_EQ(made->GetFeature(), ScoreResultField::kEntityId);
}

}  // namespace
