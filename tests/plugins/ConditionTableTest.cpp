// Compiled conditions against the predicate objects that they were compiled from, both read from one text:
// they are to give the same result for every value that a flat vector can hold.

#include "plugins/support/ConditionTable.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>
#include <cstring>
#include <limits>
#include <memory>
#include <random>
#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/predicates/CompoundPredicate.h"
#include "kestrel/predicates/DiscreteSplit.h"
#include "kestrel/predicates/Range.h"
#include "kestrel/predicates/ScaleSplit.h"
#include "kestrel/predicates/SimplePredicate.h"
#include "plugins/support/CaseVector.h"
#include "plugins/support/MiningSchema.h"
#include "plugins/support/ModelDictionaries.h"
#include "plugins/support/PredicateInputs.h"
#include "tests/plugins/TreePredicates.h"
#include "tests/support/ExpectFault.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;
using Result = ScorePredicate::PredicateResult;

constexpr double kSysmis = NumericValue::gSysmisValue;
constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kLargest = std::numeric_limits<double>::max();
constexpr double kSmallest = std::numeric_limits<double>::denorm_min();

/// Category fields of these sizes: nominal c3 ..., ordinal o3 ... Sixty-four codes fit a mask.
constexpr int kSizes[] = {3, 64, 65, 1000};

std::string CategoryField(const std::string& name, const std::string& optype, int size) {
  std::string field = "<DataField name='" + name + "' optype='" + optype + "' dataType='string'>";
  for (int i = 0; i < size; ++i)
    field += "<Value value='v" + std::to_string(i) + "'/>";
  return field + "</DataField>";
}

/// Number fields x and z and the category fields, all active, each with its slot.
class Inputs {
 public:
  Inputs() {
    const std::string number = "' optype='continuous' dataType='double'/>";
    std::string fields = "<DataField name='x" + number + "<DataField name='z" + number;
    std::string names = "<MiningField name='x'/><MiningField name='z'/>";
    for (const int size : kSizes) {
      for (const char* optype : {"categorical", "ordinal"}) {
        const std::string name = optype[0] + std::to_string(size);
        fields += CategoryField(name, optype, size);
        names += "<MiningField name='" + name + "'/>";
      }
    }
    dictionaries_.data = kestrel_test::ReadDictionary(kestrel_test::DictionaryOf(10, fields));
    const auto parsed = kestrel_test::ReadTree("<MiningSchema>" + names + "</MiningSchema>");
    schema_ = MiningSchema::Read(parsed->GetRoot(), dictionaries_.data.get());
    inputs_ = std::make_unique<PredicateInputs>(schema_, dictionaries_, vector_);
    for (const ScoreDictVar* variable : dictionaries_.data->GetScoreDictVars())
      inputs_->SlotOf(*variable);
  }

  std::unique_ptr<ScorePredicate> Read(const std::string& text) const {
    return ReadAnyPredicate(kestrel_test::ReadTree(text)->GetRoot(), *dictionaries_.data);
  }
  Condition Compile(const ScorePredicate* predicate) { return table.Compile(predicate, *inputs_); }
  const ScoreDictVar& Variable(const std::string& name) const { return *dictionaries_.data->GetVar(name); }
  size_t SlotOf(const std::string& name) const {
    return static_cast<size_t>(Variable(name).GetEncodedValueIndex());
  }
  /// A vector in which everything is missing.
  std::vector<double> Values() const {
    std::vector<double> values(static_cast<size_t>(vector_.GetSlotCount()), CaseVector::kMissingCategory);
    values[SlotOf("x")] = values[SlotOf("z")] = kSysmis;
    return values;
  }

  ConditionTable table;

 private:
  ModelDictionaries dictionaries_;
  MiningSchema schema_;
  CaseVector vector_;
  std::unique_ptr<PredicateInputs> inputs_;
};

std::string Simple(const std::string& field, const std::string& operator_text, const std::string& value) {
  return "<SimplePredicate field='" + field + "' operator='" + operator_text + "' value='" + value + "'/>";
}

std::string Asks(const std::string& field, const std::string& operator_text) {
  return "<SimplePredicate field='" + field + "' operator='" + operator_text + "'/>";
}

constexpr const char* kOrderings[] = {"lessThan", "lessOrEqual", "greaterThan", "greaterOrEqual"};
constexpr const char* kEqualities[] = {"equal", "notEqual"};
constexpr const char* kQuestions[] = {"isMissing", "isNotMissing"};

/// Both forms of one predicate on one field, asked about many values.
class Pair {
 public:
  Pair(Inputs& inputs, const std::string& field, const std::string& text)
      : inputs_(inputs),
        text_(text),
        predicate_(inputs.Read(text)),
        condition_(inputs.Compile(predicate_.get())),
        values_(inputs.Values()),
        slot_(inputs.SlotOf(field)) {}

  void ExpectSame(double value) {
    values_[slot_] = value;
    const Result wanted = predicate_->Evaluate(values_);
    const Result found = inputs_.table.Evaluate(condition_, values_.data());
    if (found != wanted) {
      ADD_FAILURE() << text_ << " of " << std::hexfloat << value << ": " << found << ", not " << wanted;
    }
  }

 private:
  Inputs& inputs_;
  std::string text_;
  std::unique_ptr<ScorePredicate> predicate_;
  Condition condition_;
  std::vector<double> values_;
  size_t slot_;
};

struct BoundRow {
  const char* why;
  const char* text;
  double bound;
};

constexpr BoundRow kBounds[] = {
    {"zero", "0", 0.0},
    {"zero with a sign", "-0.0", 0.0},
    {"a power of two, where the distance of neighbours changes", "1", 1.0},
    {"a negative one", "-1", -1.0},
    {"just below a power of two", "1023.9999999999999", 1023.9999999999999},
    {"a fraction", "0.1", 0.1},
    {"a large number", "1e300", 1e300},
    {"a small number", "1e-300", 1e-300},
    {"the smallest normal number", "2.2250738585072014e-308", std::numeric_limits<double>::min()},
    {"a number whose tolerance is a few steps", "1e-309", 1e-309},
    {"a number without tolerance", "1e-320", 1e-320},
    {"the smallest number", "4.9406564584124654e-324", kSmallest},
    {"its opposite", "-4.9406564584124654e-324", -kSmallest},
    {"the largest number", "1.7976931348623157e308", kLargest},
    {"the next to the missing number", "-1.7976931348623155e308", -1.7976931348623155e308},
    {"the missing number", "-1.7976931348623157e308", kSysmis},
    {"infinity", "1e999", kInfinity},
    {"its opposite", "-1e999", -kInfinity},
};

// Values around each bound, far beyond where the tolerance ends, and values that are no ordinary numbers.
TEST(ConditionTable, DecidesNumbersLikePredicates) {
  constexpr int kNeighbours = 300;
  Inputs inputs;
  std::vector<double> others = {kSysmis, std::nan(""), kInfinity, -kInfinity, kLargest,
                                0.0,     -0.0,         kSmallest, -kSmallest, 1.0,
                                -1.0,    1e-310,       5.5e-309,  1e300,      -1e300};
  std::mt19937_64 random(1);
  for (int i = 0; i < 500; ++i) {
    const std::uint64_t bits = random();
    double value;
    std::memcpy(&value, &bits, sizeof value);
    others.push_back(value);
  }
  for (const BoundRow& row : kBounds) {
    SCOPED_TRACE(row.why);
    std::vector<std::string> texts = {Asks("x", "isMissing"), Asks("x", "isNotMissing")};
    for (const char* operator_text : kOrderings)
      texts.push_back(Simple("x", operator_text, row.text));
    for (const char* operator_text : kEqualities)
      texts.push_back(Simple("x", operator_text, row.text));
    for (const std::string& text : texts) {
      Pair pair(inputs, "x", text);
      for (const double value : others)
        pair.ExpectSame(value);
      for (const double end : {-kInfinity, kInfinity}) {
        double value = row.bound;
        for (int i = 0; i <= kNeighbours; ++i, value = std::nextafter(value, end))
          pair.ExpectSame(value);
      }
    }
  }
}

/// Code values that a slot of so many categories can hold, and some that none should.
std::vector<double> CodesOf(int size) {
  std::vector<double> codes = {-2.0,       -1.0,    -3.0,     -0.5,     1.5,          size + 0.0,
                               size + 1.0, 1e9,     3e9,      -3e9,     std::nan(""), kInfinity,
                               -kInfinity, kSysmis, kLargest, kSmallest};
  for (int code = 0; code < size; ++code)
    codes.push_back(code);
  return codes;
}

std::string Set(const std::string& field, const std::string& boolean_operator, const std::string& members) {
  return "<SimpleSetPredicate field='" + field + "' booleanOperator='" + boolean_operator +
         "'><Array type='string'>" + members + "</Array></SimpleSetPredicate>";
}

/// Sets of one member, of all, and of every size between, in no order.
std::vector<std::string> SetsOf(const std::string& field, int size, std::mt19937_64& random) {
  std::vector<std::string> members = {"v0", "v" + std::to_string(size - 1), ""};
  for (int i = 0; i < size; ++i)
    members.back() += "v" + std::to_string(i) + " ";
  for (int i = 0; i < 20; ++i) {
    std::string some = "v" + std::to_string(random() % static_cast<unsigned>(size));
    for (std::uint64_t count = random() % static_cast<unsigned>(size); count > 0; --count)
      some += " v" + std::to_string(random() % static_cast<unsigned>(size));
    members.push_back(some);
  }
  std::vector<std::string> texts;
  for (const std::string& some : members) {
    for (const char* boolean_operator : {"isIn", "isNotIn"})
      texts.push_back(Set(field, boolean_operator, some));
  }
  return texts;
}

TEST(ConditionTable, DecidesCategoriesLikePredicates) {
  Inputs inputs;
  std::mt19937_64 random(2);
  for (const int size : kSizes) {
    for (const char optype : {'c', 'o'}) {
      const std::string field = optype + std::to_string(size);
      std::vector<std::string> texts = SetsOf(field, size, random);
      for (const char* operator_text : kQuestions)
        texts.push_back(Asks(field, operator_text));
      for (const int place : {0, 1, size / 2, size - 2, size - 1, 62, 63, 64}) {
        if (place >= size) continue;
        const std::string value = "v" + std::to_string(place);
        for (const char* operator_text : kEqualities)
          texts.push_back(Simple(field, operator_text, value));
        for (const char* operator_text : kOrderings) {
          // What holds nothing is refused by the reader.
          const bool is_empty = (place == 0 && operator_text == std::string("lessThan")) ||
                                (place == size - 1 && operator_text == std::string("greaterThan"));
          if (optype == 'o' && !is_empty) texts.push_back(Simple(field, operator_text, value));
        }
      }
      for (const std::string& text : texts) {
        Pair pair(inputs, field, text);
        for (const double code : CodesOf(size))
          pair.ExpectSame(code);
      }
    }
  }
}

TEST(ConditionTable, DecidesConstants) {
  Inputs inputs;
  const std::vector<double> values = inputs.Values();
  const struct {
    const char* why;
    const char* text;
    Result want;
  } kRows[] = {
      {"always", "<True/>", ScorePredicate::PredTrue},
      {"never", "<False/>", ScorePredicate::PredFalse},
      {"a compound of nothing", "<CompoundPredicate booleanOperator='xor'/>", ScorePredicate::PredUnknown},
      {"a compound of one", "<CompoundPredicate booleanOperator='surrogate'><True/></CompoundPredicate>",
       ScorePredicate::PredTrue},
      {"what is left of an and", "<CompoundPredicate booleanOperator='and'><True/></CompoundPredicate>",
       ScorePredicate::PredTrue},
      {"what is left of an or", "<CompoundPredicate booleanOperator='or'><False/></CompoundPredicate>",
       ScorePredicate::PredFalse},
      {"constants side by side",
       "<CompoundPredicate booleanOperator='xor'><True/><False/></CompoundPredicate>",
       ScorePredicate::PredTrue},
  };
  for (const auto& row : kRows) {
    const auto predicate = inputs.Read(row.text);
    EXPECT_EQ(inputs.table.Evaluate(inputs.Compile(predicate.get()), values.data()), row.want) << row.why;
  }
}

// ---- Compounds.

/// Random predicates on the fields of Inputs, and vectors for them.
class RandomCases {
 public:
  explicit RandomCases(const Inputs& inputs) : inputs_(inputs), random_(3) {}

  std::string Predicate(int depth) {
    if (depth == 0 || Below(4) == 0) return Atom();
    constexpr const char* kOperators[] = {"or", "and", "xor", "surrogate"};
    std::string parts;
    for (unsigned count = Below(5); count > 0; --count)
      parts += Predicate(depth - 1);
    return "<CompoundPredicate booleanOperator='" + std::string(kOperators[Below(4)]) + "'>" + parts +
           Predicate(depth - 1) + "</CompoundPredicate>";
  }

  std::vector<double> Values() {
    std::vector<double> values = inputs_.Values();
    for (const char* field : {"x", "z"}) {
      constexpr double kOdd[] = {kInfinity, -kInfinity, kLargest, std::numeric_limits<double>::quiet_NaN()};
      if (Below(3) > 0) values[inputs_.SlotOf(field)] = Below(20) == 0 ? kOdd[Below(4)] : Below(5) * 0.5;
    }
    for (const int size : kSizes) {
      for (const char optype : {'c', 'o'}) {
        double& code = values[inputs_.SlotOf(optype + std::to_string(size))];
        if (Below(3) > 0) code = Below(20) == 0 ? -1.0 : Below(static_cast<unsigned>(size));
      }
    }
    return values;
  }

 private:
  unsigned Below(unsigned end) { return static_cast<unsigned>(random_() % end); }

  std::string Atom() {
    if (Below(20) == 0) return Below(2) == 0 ? "<True/>" : "<False/>";
    if (Below(2) == 0) {
      const std::string field = Below(2) == 0 ? "x" : "z";
      if (Below(8) == 0) return Asks(field, kQuestions[Below(2)]);
      const std::string value = Below(2) == 0 ? "1" : "0.5";
      return Simple(field, Below(3) == 0 ? kEqualities[Below(2)] : kOrderings[Below(4)], value);
    }
    const bool is_ordinal = Below(2) == 0;
    const auto size = static_cast<unsigned>(kSizes[Below(4)]);
    const std::string field = (is_ordinal ? "o" : "c") + std::to_string(size);
    if (Below(8) == 0) return Asks(field, kQuestions[Below(2)]);
    if (is_ordinal && Below(2) == 0) {
      return Simple(field, kOrderings[Below(4)], "v" + std::to_string(1 + Below(size - 2)));
    }
    std::string members;
    for (unsigned count = 1 + Below(size); count > 0; --count)
      members += "v" + std::to_string(Below(size)) + " ";
    return Set(field, Below(2) == 0 ? "isIn" : "isNotIn", members);
  }

  const Inputs& inputs_;
  std::mt19937_64 random_;
};

TEST(ConditionTable, DecidesCompoundsLikePredicates) {
  Inputs inputs;
  RandomCases cases(inputs);
  std::vector<std::unique_ptr<ScorePredicate>> predicates;
  std::vector<Condition> conditions;
  // All of them in one table, and asked when it is complete.
  for (int i = 0; i < 200; ++i) {
    predicates.push_back(inputs.Read("<CompoundPredicate booleanOperator='surrogate'>" + cases.Predicate(1) +
                                     cases.Predicate(5) + "</CompoundPredicate>"));
    conditions.push_back(inputs.Compile(predicates.back().get()));
  }
  inputs.table.Seal();
  int counts[4] = {};
  for (int i = 0; i < 50; ++i) {
    const std::vector<double> values = cases.Values();
    for (size_t j = 0; j < predicates.size(); ++j) {
      const Result wanted = predicates[j]->Evaluate(values);
      EXPECT_EQ(inputs.table.Evaluate(conditions[j], values.data()), wanted) << j << ", " << i;
      ++counts[wanted];
    }
  }
  for (const int count : counts)
    EXPECT_GT(count, 200);
}

// ---- What the reader does not build.

struct RefusedRow {
  const char* why;
  const char* field;
  std::unique_ptr<ScoreSplitVar> (*make)(const ScoreDictVar*);
};

std::unique_ptr<ScoreSplitVar> ScaleOf(const ScoreDictVar* variable, double low, double high, int missing) {
  auto split = std::make_unique<ScaleSplit>(variable);
  split->PutSplit(new Range(low, high, false, true), 0);
  split->SetMissvalMap(missing);
  return split;
}

const RefusedRow kRefused[] = {
    {"a range with two ends", "x",
     [](const ScoreDictVar* variable) { return ScaleOf(variable, 1.0, 2.0, -1); }},
    {"a range that takes missing values, too", "x",
     [](const ScoreDictVar* variable) { return ScaleOf(variable, 1.0, kInfinity, 0); }},
    {"two ranges that are not all but one number", "x",
     [](const ScoreDictVar* variable) {
       auto split = ScaleOf(variable, -kInfinity, 1.0, -1);
       static_cast<ScaleSplit&>(*split).PutSplit(new Range(2.0, 3.0, false, true), 0);
       return split;
     }},
    {"three ranges", "x",
     [](const ScoreDictVar* variable) {
       auto split = ScaleOf(variable, -kInfinity, 1.0, -1);
       for (const double low : {2.0, 4.0})
         static_cast<ScaleSplit&>(*split).PutSplit(new Range(low, low + 1.0, false, true), 0);
       return split;
     }},
    {"numbers of an ordinal field", "o3",
     [](const ScoreDictVar* variable) { return ScaleOf(variable, -kInfinity, 1.0, -1); }},
    {"categories that take missing values, too", "c3",
     [](const ScoreDictVar* variable) -> std::unique_ptr<ScoreSplitVar> {
       auto split = std::make_unique<DiscreteSplit>(variable);
       split->PutSplit(1.0, 0);
       split->SetMissvalMap(0);
       return split;
     }},
};

TEST(ConditionTable, RefusesSplitsOfOtherShapes) {
  for (const RefusedRow& row : kRefused) {
    Inputs inputs;
    const SimplePredicate predicate(row.make(&inputs.Variable(row.field)).release());
    ExpectFault([&] { inputs.Compile(&predicate); }, 5, "A split of this shape: Not supported!", row.why);
  }
}

TEST(ConditionTable, APredicateWithoutSplitIsNeverDecided) {
  Inputs inputs;
  const SimplePredicate predicate;
  const std::vector<double> values = inputs.Values();
  EXPECT_EQ(inputs.table.Evaluate(inputs.Compile(&predicate), values.data()), ScorePredicate::PredUnknown);
  EXPECT_EQ(inputs.table.Evaluate(inputs.Compile(nullptr), values.data()), ScorePredicate::PredUnknown);
}

// A program may have put nothing, or a null, into a compound.
TEST(ConditionTable, CompoundsMayBeEmpty) {
  Inputs inputs;
  const std::vector<double> values = inputs.Values();
  for (const auto boolean_operator :
       {ScorePredicate::kOr, ScorePredicate::kAnd, ScorePredicate::kXor, ScorePredicate::kSurrogate}) {
    const CompoundPredicate predicate(boolean_operator);
    EXPECT_EQ(inputs.table.Evaluate(inputs.Compile(&predicate), values.data()), predicate.Evaluate(values))
        << boolean_operator;
  }
}

// ---- Room.

TEST(ConditionTable, TakesRoomForCompoundsAndLongListsAlone) {
  Inputs inputs;
  std::vector<std::unique_ptr<ScorePredicate>> predicates;
  const auto compile = [&](const std::string& text) {
    predicates.push_back(inputs.Read(text));
    inputs.Compile(predicates.back().get());
    inputs.table.Seal();
    return inputs.table.GetMemorySize();
  };
  EXPECT_EQ(compile(Simple("x", "lessThan", "1")), 0u);
  EXPECT_EQ(compile(Set("c64", "isIn", "v0 v7 v63")), 0u) << "in the condition itself";
  EXPECT_EQ(compile(Simple("c1000", "notEqual", "v500")), 16u) << "two runs";
  EXPECT_EQ(compile("<CompoundPredicate booleanOperator='or'>" + Simple("x", "lessThan", "1") +
                    Simple("z", "lessThan", "1") + "</CompoundPredicate>"),
            16u + 3 * sizeof(Condition));
}

}  // namespace
}  // namespace kestrel_tests
