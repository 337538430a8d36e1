#include "kestrel/dictionary/DictVar.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/MissingValueSet.h"
#include "kestrel/dictionary/ScoreCatNumericEncoder.h"
#include "kestrel/dictionary/ValueLabelSet.h"
#include "kestrel/dictionary/ValueProbability.h"
#include "kestrel/dictionary/ValueProbabilitySet.h"
#include "kestrel/dictionary/VarStats.h"
#include "tests/dictionary/TestValues.h"

namespace MCKestrel_800 {
namespace {

using V = ScoreDictVar;

constexpr V::VariableType kUnknownType = static_cast<V::VariableType>(3);
constexpr V::MeasureLevel kUnknownLevel = static_cast<V::MeasureLevel>(9);

TEST(DictVar, StartsWithTheDocumentedValues) {
  DictVar var("x", V::kNUMERIC_VAR);
  const DictVar& constant = var;
  EXPECT_EQ(var.GetName(), "x");
  EXPECT_EQ(var.GetLabel(), "");
  EXPECT_EQ(var.GetVarType(), V::kNUMERIC_VAR);
  EXPECT_EQ(var.GetDateTimeType(), kNoDateTime);
  EXPECT_EQ(var.GetNumericDataType(), V::kUnspecified);
  EXPECT_EQ(var.GetMLevel(), V::kContinuous);
  EXPECT_EQ(var.GetDecimal(), 0);
  EXPECT_EQ(var.GetWidth(), -1);
  EXPECT_EQ(var.GetMissingValues(), nullptr);
  EXPECT_EQ(var.GetValueLabels(), nullptr);
  EXPECT_EQ(var.GetVarStats(), nullptr);
  EXPECT_EQ(var.GetValueIndex(), -1);
  EXPECT_EQ(var.GetEncodedValueIndex(), -1);
  EXPECT_FALSE(var.GetNoSpaceTrim());
  EXPECT_FALSE(var.GetEmptyStringOK());
  EXPECT_EQ(var.GetXMeasure(), "");
  EXPECT_FALSE(var.IsFlagVariable());
  EXPECT_TRUE(var.IsUsageTypeEnable());
  EXPECT_EQ(var.GetOutlierHandleMethod(), 0);
  EXPECT_EQ(var.GetDefValue(), nullptr);
  EXPECT_EQ(var.GetValueProbabilities(), nullptr);
  EXPECT_EQ(var.GetEncoder(), nullptr);
  EXPECT_EQ(constant.GetEncoder(), nullptr);
  EXPECT_FALSE(var.IsEmptyCateValues());
  EXPECT_EQ(var.GetFalgTypeTrueValue(), "");
  EXPECT_FALSE(var.IsDerivedVariable());
  EXPECT_EQ(var.GetNumberOfCats(), 1);
}

TEST(DictVar, EnumerationsHaveTheirFixedNumbers) {
  EXPECT_EQ(static_cast<int>(V::kNUMERIC_VAR), 0);
  EXPECT_EQ(static_cast<int>(V::STRING_VAR), 1);
  EXPECT_EQ(static_cast<int>(V::kDATETIME_VAR), 4);
  EXPECT_EQ(static_cast<int>(V::kContinuous), 0);
  EXPECT_EQ(static_cast<int>(V::kOrdinal), 1);
  EXPECT_EQ(static_cast<int>(V::kNominal), 2);
  EXPECT_EQ(static_cast<int>(V::DateTimeType::kDateTimeSecondsSince1980), 12);
}

void SetEveryField(DictVar& var) {
  EXPECT_TRUE(var.SetName("y"));
  var.SetLabel("label");
  var.SetVarType(V::STRING_VAR);
  var.SetDateTimeType(kTime);
  var.SetNumericDataType(V::kInteger);
  var.SetMLevel(V::kNominal);
  var.SetFormat(2, 8);
  var.SetValueIndex(3);
  var.SetEncodedValueIndex(4);
  var.SetNoSpaceTrim(true);
  var.SetEmptyStringOK(true);
  var.SetXMeasure("m");
  EXPECT_TRUE(var.SetFlagVariable(true));
  var.SetUsageType(false);
  var.SetOutlierHandleMethod(V::kAsExtremeValues);
  var.SetEmptyCateValues(true);
  var.SetFalgTypeTrueValue("yes");
  auto* missing = new MissingValueSet;
  missing->Add(NewSingle("n/a"));
  var.SetMissingValues(missing);
  EXPECT_TRUE(var.AddScoreValueLabel(NewText("a"), "A"));
  var.SetVarStats(new VarStats(1, 2, 3, 4));
  var.SetDefValue(NewText("a"));
  auto* probabilities = new ValueProbabilitySet;
  probabilities->Add(new ValueProbability(NewText("a"), 0.5));
  var.SetValueProbabilities(probabilities);
  auto* encoder = new ScoreCatNumericEncoder;
  encoder->Encode(7.0);
  var.SetEncoder(encoder);
}

void ExpectEveryField(const DictVar& var) {
  EXPECT_EQ(var.GetName(), "y");
  EXPECT_EQ(var.GetLabel(), "label");
  EXPECT_EQ(var.GetVarType(), V::STRING_VAR);
  EXPECT_TRUE(var.IsString());
  EXPECT_EQ(var.GetDateTimeType(), kTime);
  EXPECT_EQ(var.GetNumericDataType(), V::kInteger);
  EXPECT_EQ(var.GetMLevel(), V::kNominal);
  EXPECT_EQ(var.GetDecimal(), 2);
  EXPECT_EQ(var.GetWidth(), 8);
  EXPECT_EQ(var.GetValueIndex(), 3);
  EXPECT_EQ(var.GetEncodedValueIndex(), 4);
  EXPECT_TRUE(var.GetNoSpaceTrim());
  EXPECT_TRUE(var.GetEmptyStringOK());
  EXPECT_EQ(var.GetXMeasure(), "m");
  EXPECT_TRUE(var.IsFlagVariable());
  EXPECT_FALSE(var.IsUsageTypeEnable());
  EXPECT_EQ(var.GetOutlierHandleMethod(), 2);
  EXPECT_TRUE(var.IsEmptyCateValues());
  EXPECT_EQ(var.GetFalgTypeTrueValue(), "yes");
  const StringValue a("a");
  const StringValue absent("n/a");
  EXPECT_TRUE(var.IsMissingValue(&absent));
  EXPECT_TRUE(var.IsValidValue(&a));
  EXPECT_EQ(var.GetLabelOfValue(&a), "A");
  EXPECT_EQ(var.GetVarStats()->GetStddev(), 4);
  EXPECT_EQ(var.GetDefValue()->GetString(), "a");
  EXPECT_EQ(var.GetValueProbabilities()->GetProbabilityOfValue(&a), 0.5);
  EXPECT_EQ(var.GetEncoder()->DecodeNum(0), 7);
  EXPECT_EQ(var.GetNumberOfCats(), 1);
}

TEST(DictVar, HoldsWhatItsSettersAreGiven) {
  DictVar var("x", V::kNUMERIC_VAR);
  SetEveryField(var);
  ExpectEveryField(var);
  var.SetDecimal(5);
  var.SetWidth(9);
  EXPECT_EQ(var.GetDecimal(), 5);
  EXPECT_EQ(var.GetWidth(), 9);
}

TEST(DictVar, CopiesAreDeepAndAssignmentFreesWhatWasOwned) {
  auto var = std::make_unique<DictVar>("x", V::kNUMERIC_VAR);
  SetEveryField(*var);
  const DictVar copy(*var);
  const std::unique_ptr<DictVar> clone(var->Clone());
  DictVar assigned("old", V::kNUMERIC_VAR);
  SetEveryField(assigned);
  assigned.SetName("old");
  assigned = *var;
  EXPECT_NE(copy.GetMissingValues(), var->GetMissingValues());
  EXPECT_NE(copy.GetValueLabels(), var->GetValueLabels());
  EXPECT_NE(copy.GetVarStats(), var->GetVarStats());
  EXPECT_NE(copy.GetDefValue(), var->GetDefValue());
  EXPECT_NE(copy.GetValueProbabilities(), var->GetValueProbabilities());
  EXPECT_NE(copy.GetEncoder(), static_cast<const DictVar&>(*var).GetEncoder());
  var.reset();
  ExpectEveryField(copy);
  ExpectEveryField(*clone);
  ExpectEveryField(assigned);
  const DictVar& same = assigned;
  assigned = same;
  ExpectEveryField(assigned);
  assigned = DictVar("bare", V::kNUMERIC_VAR);
  EXPECT_EQ(assigned.GetMissingValues(), nullptr);
  EXPECT_EQ(assigned.GetEncoder(), nullptr);
  const NumericValue one(1);
  EXPECT_TRUE(assigned.IsValidValue(&one));
}

TEST(DictVar, SettersLeaveTheFormerObjectToTheCaller) {
  DictVar var("x", V::kNUMERIC_VAR);
  SetEveryField(var);
  const std::unique_ptr<ScoreMissingValueSet> missing(var.GetMissingValues());
  const std::unique_ptr<ScoreValueLabelSet> labels(var.GetValueLabels());
  const std::unique_ptr<ScoreVarStats> stats(var.GetVarStats());
  const std::unique_ptr<ScoreValue> value(var.GetDefValue());
  const std::unique_ptr<ScoreValueProbabilitySet> probabilities(var.GetValueProbabilities());
  const std::unique_ptr<ScoreEncoder> encoder(var.GetEncoder());
  var.SetMissingValues(nullptr);
  var.SetValueLabels(new ValueLabelSet);
  var.SetVarStats(new VarStats);
  var.SetDefValue(nullptr);
  var.SetValueProbabilities(new ValueProbabilitySet);
  var.SetEncoder(nullptr);
  EXPECT_EQ(missing->Size(), 1u);
  EXPECT_EQ(labels->Size(), 1u);
  const StringValue absent("n/a");
  EXPECT_FALSE(var.IsMissingValue(&absent));
}

/// Notes its name in a list when it goes.
template <class Base>
class Noted : public Base {
 public:
  template <class... Arguments>
  Noted(std::vector<std::string>& gone, const char* name, Arguments... arguments)
      : Base(arguments...), gone_(gone), name_(name) {}
  ~Noted() override { gone_.emplace_back(name_); }

 private:
  std::vector<std::string>& gone_;
  const char* name_;
};

TEST(DictVar, DeletesWhatItOwnsInItsOrder) {
  std::vector<std::string> gone;
  {
    DictVar var("x", V::kNUMERIC_VAR);
    var.SetEncoder(new Noted<ScoreCatNumericEncoder>(gone, "encoder"));
    var.SetValueProbabilities(new Noted<ValueProbabilitySet>(gone, "probabilities"));
    var.SetDefValue(new Noted<NumericValue>(gone, "default", 1.0));
    var.SetVarStats(new Noted<VarStats>(gone, "statistics"));
    var.SetValueLabels(new Noted<ValueLabelSet>(gone, "labels"));
    var.SetMissingValues(new Noted<MissingValueSet>(gone, "missing"));
  }
  EXPECT_EQ(gone, (std::vector<std::string>{"missing", "labels", "statistics", "default", "probabilities",
                                            "encoder"}));
}

/// Sets of classes derived from ours, which show something else than they hold.
class NothingMissing : public MissingValueSet {
 public:
  std::vector<const ScoreValueRange*> GetMissingValues() const override { return {}; }
};
class NoLabels : public ValueLabelSet {
 public:
  const std::vector<ScoreValueLabel*>& GetAllValueLabels() const override { return none_; }

 private:
  std::vector<ScoreValueLabel*> none_;
};

TEST(DictVar, AsksSetsOfDerivedClassesThroughTheInterface) {
  const NumericValue one(1);
  DictVar var("x", V::kNUMERIC_VAR);
  var.SetMissingValues(new NothingMissing);
  var.GetMissingValues()->Add(NewSingle(1));
  EXPECT_FALSE(var.IsMissingValue(&one));
  var.SetMLevel(V::kNominal);
  var.SetValueLabels(new NoLabels);
  EXPECT_TRUE(var.AddScoreValueLabel(NewNumber(1), "one"));
  EXPECT_FALSE(var.IsValidValue(&one));
}

TEST(DictVar, EqualityIsThatOfTheNames) {
  const DictVar a("a", V::kNUMERIC_VAR);
  const DictVar alsoA("a", V::STRING_VAR);
  const DictVar upper("A", V::kNUMERIC_VAR);
  EXPECT_TRUE(a == alsoA);
  EXPECT_FALSE(a == upper);
}

TEST(DictVar, RefusesAnEmptyName) {
  DictVar var("x", V::kNUMERIC_VAR);
  EXPECT_FALSE(var.SetName(""));
  EXPECT_EQ(var.GetName(), "x");
}

TEST(DictVar, TextFlagsAreForTextVariablesAlone) {
  for (const V::VariableType type : {V::kNUMERIC_VAR, V::STRING_VAR, V::kDATETIME_VAR, kUnknownType}) {
    DictVar var("x", type);
    var.SetNoSpaceTrim(true);
    var.SetEmptyStringOK(true);
    EXPECT_EQ(var.GetNoSpaceTrim(), type == V::STRING_VAR) << type;
    EXPECT_EQ(var.GetEmptyStringOK(), type == V::STRING_VAR) << type;
    EXPECT_EQ(var.IsString(), type == V::STRING_VAR) << type;
  }
}

TEST(DictVar, OnlyACategoricalVariableIsAFlag) {
  DictVar var("x", V::kNUMERIC_VAR);
  EXPECT_FALSE(var.SetFlagVariable(true));
  EXPECT_FALSE(var.IsFlagVariable());
  var.SetMLevel(kUnknownLevel);
  EXPECT_FALSE(var.SetFlagVariable(true));
  for (const V::MeasureLevel level : {V::kOrdinal, V::kNominal}) {
    var.SetMLevel(level);
    EXPECT_TRUE(var.SetFlagVariable(true));
    EXPECT_TRUE(var.IsFlagVariable());
    EXPECT_TRUE(var.SetFlagVariable(false));
  }
}

TEST(DictVar, NumberOfCatsFollowsLevelAndLabels) {
  DictVar var("x", V::kNUMERIC_VAR);
  EXPECT_EQ(var.GetNumberOfCats(), 1);
  var.SetMLevel(V::kNominal);
  EXPECT_EQ(var.GetNumberOfCats(), 0);
  var.AddScoreValueLabel(NewNumber(1), "one");
  var.AddScoreValueLabel(NewNumber(2), "two");
  EXPECT_EQ(var.GetNumberOfCats(), 2);
  var.SetMLevel(V::kContinuous);
  EXPECT_EQ(var.GetNumberOfCats(), 1);
}

TEST(DictVar, LabelOfValueIsEmptyWithoutLabels) {
  DictVar var("x", V::kNUMERIC_VAR);
  const NumericValue one(1);
  EXPECT_EQ(var.GetLabelOfValue(&one), "");
  var.AddScoreValueLabel(NewNumber(1), "one");
  EXPECT_EQ(var.GetLabelOfValue(&one), "one");
  EXPECT_EQ(var.GetLabelOfValue(nullptr), "");
}

TEST(DictVar, ToMyValueFollowsTheStorageKind) {
  const std::unique_ptr<ScoreValue> number(DictVar("x", V::kNUMERIC_VAR).ToMyValue("2.5"));
  EXPECT_EQ(number->GetType(), ScoreValue::kNumeric);
  EXPECT_EQ(number->GetDouble(), 2.5);
  const std::unique_ptr<ScoreValue> none(DictVar("x", V::kNUMERIC_VAR).ToMyValue("abc"));
  EXPECT_TRUE(none->IsSystemMissingValue());
  const std::unique_ptr<ScoreValue> text(DictVar("x", V::STRING_VAR).ToMyValue("2.5 "));
  EXPECT_EQ(text->GetType(), ScoreValue::kString);
  EXPECT_EQ(text->GetString(), "2.5 ");
  EXPECT_EQ(DictVar("x", V::kDATETIME_VAR).ToMyValue("2.5"), nullptr);
  EXPECT_EQ(DictVar("x", kUnknownType).ToMyValue("2.5"), nullptr);
}

TEST(DictVar, AddScoreValueLabelKeepsTheOwnershipRules) {
  DictVar var("x", V::kNUMERIC_VAR);
  EXPECT_FALSE(var.AddScoreValueLabel(nullptr, "label"));
  ASSERT_NE(var.GetValueLabels(), nullptr);
  EXPECT_EQ(var.GetValueLabels()->Size(), 0u);

  DictVar other("x", V::kNUMERIC_VAR);
  const std::unique_ptr<ScoreValue> refused(NewNumber(1));
  EXPECT_FALSE(other.AddScoreValueLabel(refused.get(), ""));
  ASSERT_NE(other.GetValueLabels(), nullptr);
  EXPECT_EQ(other.GetValueLabels()->Size(), 0u);
  EXPECT_EQ(refused->GetDouble(), 1);

  EXPECT_TRUE(var.AddScoreValueLabel(NewNumber(1), "one"));
  // A duplicate is deleted: the leak check of the sanitizer build watches it.
  EXPECT_FALSE(var.AddScoreValueLabel(NewNumber(1), "again"));
  EXPECT_EQ(var.GetValueLabels()->Size(), 1u);
  const NumericValue one(1);
  EXPECT_EQ(var.GetLabelOfValue(&one), "one");
}

TEST(DictVar, AddScoreValueLabelFreesTheValueWhenAForeignSetRefuses) {
  DictVar var("x", V::kNUMERIC_VAR);
  auto* set = new ForeignLabelSet;
  set->refuses = true;
  var.SetValueLabels(set);
  EXPECT_FALSE(var.AddScoreValueLabel(NewNumber(1), "one"));
  set->refuses = false;
  EXPECT_TRUE(var.AddScoreValueLabel(NewNumber(1), "one"));
  EXPECT_FALSE(var.AddScoreValueLabel(NewNumber(1), "one"));
}

TEST(DictVar, DisplayNamesTypeAndLevel) {
  struct Row {
    V::VariableType type;
    V::MeasureLevel level;
    const char* text;
  };
  const Row rows[] = {
      {V::kNUMERIC_VAR, V::kContinuous, "Var Type = kNUMERIC_VAR; Var level =  Continuous; \n"},
      {V::STRING_VAR, V::kOrdinal, "Var Type = STRING_VAR; Var level =  Ordinal; \n"},
      {V::kDATETIME_VAR, V::kNominal, "Var level =  Nominal; \n"},
      {kUnknownType, kUnknownLevel, "Var level = unknown;\n"},
  };
  for (const Row& row : rows) {
    DictVar var("n", row.type);
    var.SetLabel("l");
    var.SetMLevel(row.level);
    EXPECT_EQ(DisplayOf(var), std::string("Start ScoreDictVar Display:\nVar Name = n; Var Lable = l; ") +
                                  row.text + "End of ScoreDictVar Display.\n\n");
  }
}

TEST(DictVar, DisplayShowsLabelsMissingValuesAndMeasureInThatOrder) {
  DictVar var("n", V::STRING_VAR);
  var.SetMLevel(V::kNominal);
  var.AddScoreValueLabel(NewText("a"), "A");
  auto* missing = new MissingValueSet;
  missing->Add(NewSingle("z"));
  var.SetMissingValues(missing);
  var.SetXMeasure("m");
  EXPECT_EQ(DisplayOf(var),
            "Start ScoreDictVar Display:\n"
            "Var Name = n; Var Lable = ; Var Type = STRING_VAR; Var level =  Nominal; \n"
            "Start ScoreValueLabelSet Display:\nValue: a;  Label: A\nEnd of ScoreValueLabelSet Display.\n\n"
            " Begin MissingValueSet Display:\n"
            "  Start Range Display   \nMinValue: z;  MaxValue: z; High End included; lower End included\n"
            " End of Range Display\n\n"
            "End MissingValueSet Display.\n"
            "x-Measure: m\n"
            "End of ScoreDictVar Display.\n\n");
}

}  // namespace
}  // namespace MCKestrel_800
