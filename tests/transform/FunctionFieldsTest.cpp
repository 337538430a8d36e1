// The built-in functions as derived fields compute them: each row as a tree of constants, and as one of
// fields.

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <thread>
#include <vector>

#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/dictionary/DictVar.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/transform/BuiltinFunctions.h"
#include "kestrel/transform/FunctionTreeImp.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/TransformationDictionary.h"
#include "tests/transform/FunctionRows.h"

namespace MCKestrel_800 {
namespace {

using kestrel_tests::AllFunctionRows;
using kestrel_tests::FunctionRow;
using kestrel_tests::IsAsWanted;
using kestrel_tests::RowValue;

std::string FieldName(std::size_t index) {
  return "field" + std::to_string(index);
}

FunctionTreeImp* Constant(const RowValue& value) {
  ApplyNodeStats stats;
  stats.SetConstNode(true);
  stats.SetValue(value.ToValue().release());
  return new FunctionTreeImp(stats);
}

FunctionTreeImp* Field(const std::string& name) {
  ApplyNodeStats stats;
  stats.SetParameterName(name);
  return new FunctionTreeImp(stats);
}

/// Whether an argument stands in the document and not in the case.
bool IsWord(const FunctionRow& row, std::size_t argument) {
  return argument == 1 && FindBuiltinFunction(row.name)->code == kOutlierHandleFunction;
}

FunctionTree* TreeOf(const FunctionRow& row, bool of_fields) {
  const BuiltinFunction& function = *FindBuiltinFunction(row.name);
  ApplyNodeStats stats;
  stats.SetParameterName(row.name);
  stats.SetTransFunction(function.code);
  for (const std::vector<RowValue>& array : row.arrays) {
    std::vector<ScoreValue*> values;
    for (const RowValue& value : array)
      values.push_back(value.ToValue().release());
    stats.AddArray(values);
  }
  auto* tree = new FunctionTreeImp(stats);
  for (std::size_t i = 0; i < row.arguments.size(); ++i)
    tree->Add(of_fields && !IsWord(row, i) ? Field(FieldName(i)) : Constant(row.arguments[i]));
  return tree;
}

/// The fields of a row, and their values as a case.
struct Inputs {
  explicit Inputs(const FunctionRow& row) : record(8) {
    for (std::size_t i = 0; i < row.arguments.size(); ++i) {
      const RowValue& argument = row.arguments[i];
      const auto type = argument.kind == ScoreValue::kString     ? ScoreDictVar::STRING_VAR
                        : argument.kind == ScoreValue::kDateTime ? ScoreDictVar::kDATETIME_VAR
                                                                 : ScoreDictVar::kNUMERIC_VAR;
      auto variable = std::make_unique<DictVar>(FieldName(i), type);
      // The categories that an imputation chooses from.
      if (!row.arrays.empty() && type == ScoreDictVar::kNUMERIC_VAR) {
        for (const char* label : {"1", "2", "3"})
          variable->AddScoreValueLabel(new NumericValue(std::string(label)), label);
      }
      dictionary.AddVar(FieldName(i), variable.release());
      record.Add(FieldName(i), argument.ToValue().release());
    }
  }

  BaseDictionary dictionary;
  CaseRecord record;
};

RowValue Compute(const FunctionRow& row, bool of_fields) {
  Inputs inputs(row);
  TransformVar field(
      "result", row.want.kind == ScoreValue::kString ? ScoreDictVar::STRING_VAR : ScoreDictVar::kNUMERIC_VAR);
  field.AddFieldNameAndTransExpression("", TransExpression::kApply);
  field.SetRoot(TreeOf(row, of_fields));
  const ScoreValue* value = field.GetTransformedValue(&inputs.record, &inputs.dictionary, nullptr);
  if (value->GetType() != ScoreValue::kString) return value->GetDouble();
  const auto& text = dynamic_cast<const StringValue&>(*value);
  return kestrel_tests::Wide(text.GetText().c_str(), text.GetLength());
}

TEST(FunctionFields, ConstantsGiveWhatTheRowsSay) {
  for (const FunctionRow& row : AllFunctionRows()) {
    if (FindBuiltinFunction(row.name)->code == kImputeFunction) continue;  // the categories are a field's
    const RowValue result = Compute(row, false);
    EXPECT_TRUE(IsAsWanted(result, row.want, row.tolerance)) << row << " is " << result;
  }
}

TEST(FunctionFields, FieldsGiveWhatTheRowsSay) {
  for (const FunctionRow& row : AllFunctionRows()) {
    bool keeps_lengths = true;
    for (const RowValue& argument : row.arguments) {
      keeps_lengths = keeps_lengths && (argument.kind != ScoreValue::kString ||
                                        static_cast<std::size_t>(argument.length) == argument.text.size());
    }
    // What a record holds has no other length than its own.
    if (!keeps_lengths) continue;
    const RowValue result = Compute(row, true);
    EXPECT_TRUE(IsAsWanted(result, row.want, row.tolerance)) << row << " is " << result;
  }
}

/// (x + 1)^2 over 100 numbers, computed by a dictionary.
double SumOfCases(TransformationDictionary& dictionary, double first) {
  CaseRecord record(1);
  record.Add("x", new NumericValue());
  double sum = 0.0;
  for (int i = 0; i < 100; ++i) {
    record.SetValue(0, first + i);
    sum += dictionary.GetValuesForDerivedVars(&record, nullptr)->Get("square")->GetDouble();
  }
  return sum;
}

TEST(FunctionFields, ThreadsWithClonesComputeTheirOwnCases) {
  ApplyNodeStats power, plus;
  power.SetTransFunction(kPowFunction);
  plus.SetTransFunction(kPlusFunction);
  auto* root = new FunctionTreeImp(power);
  auto* sum = new FunctionTreeImp(plus);
  root->Add(sum);
  sum->Add(Field("x"));
  sum->Add(Constant(1.0));
  root->Add(Constant(2.0));
  TransformationDictionary dictionary;
  auto* square = new TransformVar("square", ScoreDictVar::kNUMERIC_VAR);
  square->AddFieldNameAndTransExpression("", TransExpression::kApply);
  square->SetRoot(root);
  dictionary.AddVar("square", square);
  dictionary.AddDerievedVarName("square");
  dictionary.SetUpDerivedCaseRecord();

  std::vector<std::unique_ptr<TransformationDictionary>> clones;
  std::vector<double> sums(2);
  std::vector<std::thread> threads;
  for (std::size_t i = 0; i < sums.size(); ++i)
    clones.emplace_back(dictionary.Clone());
  for (std::size_t i = 0; i < sums.size(); ++i) {
    threads.emplace_back([&, i] {
      for (int round = 0; round < 100; ++round)
        sums[i] = SumOfCases(*clones[i], static_cast<double>(100 * i));
    });
  }
  for (std::thread& thread : threads)
    thread.join();
  // The squares up to 100, and those from 101 to 200.
  EXPECT_EQ(sums[0], 338350.0);
  EXPECT_EQ(sums[1], 2686700.0 - 338350.0);
}

}  // namespace
}  // namespace MCKestrel_800
