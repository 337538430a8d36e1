// Models of every kind over derived fields of every kind.

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <thread>
#include <tuple>
#include <vector>

#include "kestrel/model/Results.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/TransformationDictionary.h"
#include "tests/plugins/DerivedModelText.h"
#include "tests/plugins/TreePredicates.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

constexpr double kMissing = NumericValue::gSysmisValue;

/// A derived field of each kind of expression, what it is for the case below, and a predicate that is true
/// there.
struct KindRow {
  const char* why;
  std::string type;
  std::string expression;
  std::string number;     ///< empty for texts
  std::string category;   ///< empty for what is no category
  std::string predicate;  ///< on the field d; empty where categories are not known
};

const Case kCase = {{"x", 4.0}, {"z", 1.5}, {"n", 2.0}, {"g", "b"}, {"t", "Oslo"}};

const KindRow kKinds[] = {
    {"a constant", "continuous double", Constant("2.5"), "2.5", "", Compare("d", "equal", "2.5")},
    {"a constant text", "categorical string", "<Constant dataType='string'>red</Constant>", "", "red",
     Compare("d", "equal", "red")},
    {"a field", "continuous double", FieldRef("x"), "4", "", Compare("d", "greaterThan", "3")},
    {"a field's text", "categorical string", FieldRef("t"), "", "Oslo", ""},
    {"a line", "continuous double", NormContinuous("x", LinearNorm("0", "1") + LinearNorm("8", "5")), "3", "",
     Compare("d", "lessOrEqual", "3")},
    {"an indicator", "continuous double", NormDiscrete("g", "b"), "1", "",
     Compare("d", "greaterThan", "0.5")},
    {"an indicator as a category", "categorical integer", NormDiscrete("g", "b"), "1", "1",
     Compare("d", "equal", "1")},
    {"bins", "categorical string", Bins("x", "2", "5"), "", "mid", Compare("d", "equal", "mid")},
    {"bins in order", "ordinal string", Bins("x", "2", "5"), "", "mid", Compare("d", "greaterThan", "low")},
    {"a table of numbers", "continuous double", Map("g", "10", "20", "30"), "20", "",
     Compare("d", "lessThan", "21")},
    {"a table of texts", "categorical string", Map("g", "no", "maybe", "yes"), "", "maybe",
     "<SimpleSetPredicate field='d' booleanOperator='isIn'><Array type='string' n='2'>yes "
     "maybe</Array></SimpleSetPredicate>"},
    {"a function", "continuous double", Apply("+", FieldRef("x") + FieldRef("z")), "5.5", "",
     Compare("d", "notEqual", "5")},
    {"a function of a text", "categorical string", Apply("uppercase", FieldRef("t")), "", "OSLO", ""},
};

TEST(DerivedModels, RegressionsReadEveryKind) {
  for (const KindRow& row : kKinds) {
    const std::string field = Derived("d", row.type, row.expression);
    for (const DerivedDocument& document : {DerivedDocument{field, ""}, DerivedDocument{"", field}}) {
      if (!row.number.empty()) {
        EXPECT_EQ(ScoreOf(document.Regression(Number("d")), kCase), row.number) << row.why;
        EXPECT_EQ(ScoreOf(document.Regression("<PredictorTerm coefficient='2'><FieldRef field='d'/><FieldRef "
                                              "field='x'/></PredictorTerm>"),
                          kCase),
                  ScoreOf(document.Regression(Number("d", "8")), kCase))
            << row.why;
      }
      if (!row.category.empty()) {
        EXPECT_EQ(ScoreOf(document.Regression(Category("d", row.category, "3")), kCase), "3") << row.why;
      }
    }
  }
}

TEST(DerivedModels, PredicatesReadEveryKind) {
  for (const KindRow& row : kKinds) {
    if (row.predicate.empty()) continue;
    const std::string field = Derived("d", row.type, row.expression);
    for (const DerivedDocument& document : {DerivedDocument{field, ""}, DerivedDocument{"", field}}) {
      EXPECT_EQ(ScoreOf(document.Tree(row.predicate), kCase), "1") << row.why;
      EXPECT_EQ(ScoreOf(document.Rules(row.predicate), kCase), "1") << row.why;
    }
  }
}

TEST(DerivedModels, LocalFieldsReadGlobalOnes) {
  const DerivedDocument document{
      Derived("a", "continuous double", Apply("*", FieldRef("x") + Constant("2"))) +
          Derived("b", "categorical string", Bins("a", "5", "9")),
      Derived("c", "continuous double", NormDiscrete("b", "mid")) +
          Derived("d", "continuous double", Apply("+", FieldRef("c") + FieldRef("a")))};
  const std::string want = "9";  // x = 4: a = 8, b = mid, c = 1, d = 9
  EXPECT_EQ(ScoreOf(document.Regression(Number("d")), kCase), want);
  EXPECT_EQ(ScoreOf(document.Tree(Compare("d", "equal", want)), kCase), "1");
  EXPECT_EQ(ScoreOf(document.Rules(Compare("d", "equal", want)), kCase), "1");
  EXPECT_EQ(ScoreOf(document.Regression(Number("d") + Category("b", "mid", "100")), kCase), "109");
}

// By hand: d = 2x, e = 1 where x is above 3, b = the bin of z.
TEST(DerivedModels, ARegressionOnDerivedFieldsAlone) {
  const DerivedDocument document{
      Derived("d", "continuous double", Apply("*", FieldRef("x") + Constant("2"))),
      Derived("e", "continuous double", Apply("greaterThan", FieldRef("x") + Constant("3"))) +
          Derived("b", "categorical string", Bins("z", "1", "2", "mapMissingTo='none'"))};
  const auto model = BuildAny(document.Regression(
      Number("d", "0.5") + "<NumericPredictor name='d' exponent='2' coefficient='0.25'/>" +
      Number("e", "10") + Category("b", "low", "100") + Category("b", "mid", "200") +
      Category("b", "none", "-1") +
      "<PredictorTerm coefficient='3'><FieldRef field='d'/><FieldRef field='e'/></PredictorTerm>"));
  // x = 4: 0.5 * 8 + 0.25 * 64 + 10 * 1 + 3 * 8 * 1 = 54
  EXPECT_EQ(ScoreOf(*model, {{"x", 4.0}, {"z", 0.5}}), "154");
  EXPECT_EQ(ScoreOf(*model, {{"x", 4.0}, {"z", 1.5}}), "254");
  EXPECT_EQ(ScoreOf(*model, {{"x", 4.0}, {"z", 2.5}}), "54");
  EXPECT_EQ(ScoreOf(*model, {{"x", 4.0}, {"z", kMissing}}), "53");
  // x = 1: 0.5 * 2 + 0.25 * 4 = 2
  EXPECT_EQ(ScoreOf(*model, {{"x", 1.0}, {"z", 2.5}}), "2");
  EXPECT_EQ(ScoreOf(*model, {{"x", kMissing}, {"z", 2.5}}), "90027");
  ASSERT_EQ(model->GetPredictors().size(), 2u);
  EXPECT_EQ(model->GetPredictors()[0]->GetName(), "x");
  EXPECT_EQ(model->GetPredictors()[1]->GetName(), "z");
}

// Of a derived category: a value that is none of the listed ones counts as missing in nominal predicates.
TEST(DerivedModels, PredicatesSeeDerivedValuesAsRecordsDo) {
  const std::string listed = "<Value value='low'/><Value value='mid'/>";
  const std::string bins = Bins("x", "1", "5");
  const DerivedDocument document{
      "", Derived("b", "categorical string", bins) +
              "<DerivedField name='few' optype='categorical' dataType='string'>" + bins + listed +
              "</DerivedField><DerivedField name='order' optype='ordinal' dataType='string'>" + bins +
              "<Value value='low'/><Value value='mid'/><Value value='high'/></DerivedField>" +
              Derived("num", "continuous double", Apply("*", FieldRef("x") + Constant("2")))};
  const auto one_of = [](const std::string& field, const std::string& values) {
    return "<SimpleSetPredicate field='" + field + "' booleanOperator='isIn'><Array type='string'>" + values +
           "</Array></SimpleSetPredicate>";
  };
  const auto missing = [](const std::string& field) {
    return "<SimplePredicate field='" + field + "' operator='isMissing'/>";
  };
  const auto compound = [](const std::string& text, const std::string& parts) {
    return "<CompoundPredicate booleanOperator='" + text + "'>" + parts + "</CompoundPredicate>";
  };
  struct Row {
    std::string predicate;
    const char* want;  ///< for x = 0, 3, 9 and missing: true, false or unknown
  };
  const Row rows[] = {
      {Compare("b", "equal", "mid"), "010?"},
      {Compare("b", "notEqual", "mid"), "101?"},
      {one_of("b", "low high"), "101?"},
      {missing("b"), "0001"},
      {Compare("few", "equal", "mid"), "01??"},
      {one_of("few", "low"), "10??"},
      {missing("few"), "0011"},
      {Compare("order", "greaterOrEqual", "mid"), "011?"},
      {Compare("order", "lessThan", "mid"), "100?"},
      {missing("order"), "0001"},
      {Compare("num", "lessOrEqual", "6"), "110?"},
      {Compare("num", "equal", "6"), "010?"},
      {missing("num"), "0001"},
      {compound("and", Compare("b", "equal", "mid") + Compare("num", "greaterThan", "2")), "010?"},
      {compound("or", Compare("b", "equal", "mid") + Compare("x", "greaterThan", "7")), "011?"},
      {compound("xor", Compare("b", "equal", "low") + Compare("num", "lessThan", "10")), "010?"},
      {compound("surrogate", Compare("num", "greaterThan", "7") + Compare("g", "equal", "b")), "001S"},
  };
  const Cell cells[] = {0.0, 3.0, 9.0, kMissing};
  for (const Row& row : rows) {
    const std::string text = document.Tree(row.predicate);
    const auto model = BuildAny(text);
    const auto rules = BuildAny(document.Rules(row.predicate));
    auto& tree = static_cast<TreeModel&>(*model);
    // The predicate as an object, on records and on the vector.
    const auto parsed = kestrel_test::ReadTree(row.predicate);
    const std::unique_ptr<ScorePredicate> object =
        ReadAnyPredicate(parsed->GetRoot(), *model->GetDictionary(), model->GetTransformationDictionary());
    ASSERT_NE(object, nullptr);
    EXPECT_TRUE(object->IsDerivedPredictor());
    for (int i = 0; i < 4; ++i) {
      const CaseRecord record = RecordOf({{"x", cells[i]}, {"g", "b"}});
      const std::string place = row.predicate + ", case " + std::to_string(i);
      const bool is_unknown = row.want[i] == '?';
      const bool is_true = row.want[i] == '1' || row.want[i] == 'S';
      EXPECT_EQ(ScoreOf(*model, record), is_unknown ? "90027" : is_true ? "1" : "0") << place;
      EXPECT_EQ(ScoreOf(*rules, record), is_true ? "1" : "0") << place;
      const std::vector<double> values(
          tree.GetTree().inputs.GetValues(),
          tree.GetTree().inputs.GetValues() + tree.GetTree().inputs.GetSlotCount());
      RegResult result;
      EXPECT_EQ(tree.ScoreVector(values.data(), &result).IsOK(), !is_unknown) << place;
      const ScorePredicate::PredicateResult want = is_unknown           ? ScorePredicate::PredUnknown
                                                   : row.want[i] == 'S' ? ScorePredicate::PredSurrogateTrue
                                                   : is_true            ? ScorePredicate::PredTrue
                                                                        : ScorePredicate::PredFalse;
      EXPECT_EQ(object->Evaluate(values), want) << place;
      const CaseRecord* const derived =
          model->GetTransformationDictionary()->GetValuesForDerivedVars(&record, model->GetDictionary());
      // The record road has no rule for an empty text that is none of an ordinal field's categories.
      const bool differs = i == 3 && row.predicate.find("order") != std::string::npos;
      if (!differs) {
        EXPECT_EQ(object->Evaluate(&record, derived), want) << place;
      }
    }
  }
}

TEST(DerivedModels, ADerivedFieldMayBeAMiningField) {
  const DerivedDocument document{Derived("d", "continuous double", Apply("*", FieldRef("x") + Constant("2"))),
                                 "", "<MiningField name='d' missingValueReplacement='100'/>"};
  const std::string predicate = Compare("d", "greaterThan", "50");
  for (const auto& [x, number, test] :
       {std::tuple(4.0, "8", "0"), std::tuple(30.0, "60", "1"), std::tuple(kMissing, "100", "1")}) {
    const Case cells = {{"x", x}};
    EXPECT_EQ(ScoreOf(document.Regression(Number("d")), cells), number);
    EXPECT_EQ(ScoreOf(document.Tree(predicate), cells), test);
    EXPECT_EQ(ScoreOf(document.Rules(predicate), cells), test);
  }
  const auto model = BuildAny(document.Regression(Number("d")));
  EXPECT_EQ(model->GetVarRole("d"), ScoreModel::kPredictor);
  ASSERT_EQ(model->GetPredictors().size(), 1u);
  EXPECT_EQ(model->GetPredictors()[0], model->GetDictionary()->GetVar("x"));
}

TEST(DerivedModels, TheModelHasItsDerivedFields) {
  const std::string global = Derived("a", "continuous double", FieldRef("x"));
  const std::string local = Derived("b", "continuous double", FieldRef("a"));
  const auto model = BuildAny(DerivedDocument{global, local}.Regression(Number("x")));
  TransformationDictionary* const derived = model->GetTransformationDictionary();
  ASSERT_NE(derived, nullptr);
  EXPECT_EQ(derived->GetDerivedVarNames(), (std::vector<std::string>{"a", "b"}));
  // It is ready for use although the model needs none of the fields.
  const CaseRecord record = RecordOf({{"x", 3.0}});
  ASSERT_NE(derived->GetValuesForDerivedVars(&record, model->GetDictionary()), nullptr);
  EXPECT_EQ(derived->GetVarValue("b")->GetDouble(), 3.0);
  EXPECT_EQ(BuildAny(DerivedDocument{}.Regression(Number("x")))->GetTransformationDictionary(), nullptr);
  EXPECT_EQ(
      BuildAny(DerivedDocument{"<Extension/>", ""}.Regression(Number("x")))->GetTransformationDictionary(),
      nullptr);
}

// A host that has the dictionary and the model's element alone: the element's own derived fields.
TEST(DerivedModels, AnElementHasItsOwnDerivedFields) {
  const std::string local = Derived("d", "continuous double", Apply("*", FieldRef("x") + Constant("3")));
  const std::string document = DerivedDocument{"", local}.Regression(Number("d"));
  const auto parsed = kestrel_test::ReadTree(document);
  const auto dictionary = kestrel_test::ReadDictionary(document);
  RegressionTranslator translator;
  const std::unique_ptr<ScoreModel> model(translator.ParseFromTree(
      FirstChild(parsed->GetRoot(), u"RegressionModel"), dictionary.get(), nullptr, std::string()));
  EXPECT_EQ(ScoreOf(*model, {{"x", 2.0}}), "6");
}

// Such as one that keeps computed columns: in this model they are columns like any other.
TEST(DerivedModels, AHostsDictionaryMayHoldDerivedVariables) {
  const std::string local = Derived("d", "continuous double", Apply("*", FieldRef("kept") + Constant("3")));
  const std::string fields = "<MiningField name='kept'/><MiningField name='x'/>";
  const DerivedDocument document{"", local, fields};
  const auto dictionary = kestrel_test::ReadDictionary(document.Rules("<True/>"));
  auto kept = std::make_unique<TransformVar>("kept", ScoreDictVar::kNUMERIC_VAR);
  dictionary->AddVar("kept", kept.release());
  const DerivedDocument without{"", "", fields};
  const auto build = [&dictionary](const std::string& text) {
    const auto parsed = kestrel_test::ReadTree(text);
    TreeTranslator translator;
    return std::unique_ptr<ScoreModel>(translator.ParseFromTree(FirstChild(parsed->GetRoot(), u"TreeModel"),
                                                                dictionary.get(), nullptr, std::string()));
  };
  const Case cells = {{"kept", 2.0}, {"x", 1.0}};
  EXPECT_EQ(ScoreOf(*build(without.Tree(Compare("kept", "equal", "2"))), cells), "1");
  EXPECT_EQ(ScoreOf(*build(document.Tree(Compare("d", "equal", "6"))), cells), "1");
  EXPECT_EQ(ScoreOf(*build(document.Tree("<CompoundPredicate booleanOperator='and'>" +
                                         Compare("kept", "equal", "2") + Compare("d", "equal", "6") +
                                         "</CompoundPredicate>")),
                    cells),
            "1");
}

TEST(DerivedModels, TwoModelsServeTwoThreads) {
  const DerivedDocument document{
      Derived("a", "continuous double", Apply("*", FieldRef("x") + Constant("2"))),
      Derived("b", "categorical string", Bins("a", "100", "200")) +
          Derived("c", "continuous double", Apply("+", FieldRef("a") + FieldRef("z")))};
  const std::string text = document.Regression(Number("c") + Category("b", "mid", "1000"));
  const auto work = [&text](int start, int& wrong) {
    const auto model = BuildAny(text);
    CaseRecord record = RecordOf({{"x", 0.0}, {"z", 0.0}});
    const std::unique_ptr<ScoreResult> result(model->MakeResult());
    for (int i = start; i < start + 5000; ++i) {
      record.SetValue(0, static_cast<double>(i % 150));
      record.SetValue(1, static_cast<double>(i));
      const double a = 2.0 * (i % 150);
      const double want = a + i + (a >= 100 && a <= 200 ? 1000 : 0);
      if (!model->Score(&record, result.get()).IsOK() || result->GetPrediction()->GetDouble() != want)
        ++wrong;
    }
  };
  int wrong[2] = {0, 0};
  std::thread first([&] { work(0, wrong[0]); });
  std::thread second([&] { work(70000, wrong[1]); });
  first.join();
  second.join();
  EXPECT_EQ(wrong[0] + wrong[1], 0);
}

// A chain and a doubling of fields cost what their size says.
TEST(DerivedModels, LongChainsAreScored) {
  constexpr int kLength = 3000;
  std::string fields = Derived("d0", "continuous double", FieldRef("x"));
  for (int i = 1; i < kLength; ++i) {
    const std::string before = FieldRef("d" + std::to_string(i - 1));
    fields += Derived("d" + std::to_string(i), "continuous double", Apply("max", before + before));
  }
  const auto model =
      BuildAny(DerivedDocument{"", fields}.Regression(Number("d" + std::to_string(kLength - 1))));
  EXPECT_EQ(ScoreOf(*model, {{"x", 5.0}}), "5");
  ASSERT_EQ(model->GetPredictors().size(), 1u);
}

}  // namespace
}  // namespace kestrel_tests
