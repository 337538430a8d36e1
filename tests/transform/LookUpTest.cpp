// Bins and encodings are searched; a walk over them in their order says what must be found.

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <memory>
#include <random>
#include <string>
#include <vector>

#include "kestrel/predicates/Range.h"
#include "tests/transform/DerivedFields.h"

namespace {

using namespace MCKestrel_800;
using namespace kestrel_test;

constexpr double kInfinity = std::numeric_limits<double>::infinity();

/// The numbers themselves, and those around them where the tolerances begin and end.
std::vector<double> Neighbours(const std::vector<double>& numbers) {
  std::vector<double> all = {kSysmis, kInfinity, -kInfinity, 0.0, -0.0, 1e300, -1e300};
  for (const double number : numbers) {
    all.push_back(number);
    for (const double steps : {0.5, 0.99, 1.0, 1.01, 2.0, 50.0}) {
      all.push_back(number + std::abs(number) * steps * NumericValue::fEpsilon);
      all.push_back(number - std::abs(number) * steps * NumericValue::fEpsilon);
    }
    all.push_back(std::nextafter(number, kInfinity));
    all.push_back(std::nextafter(number, -kInfinity));
  }
  return all;
}

/// The result of a walk: 1 more than the row, or 0.
double Walk(const std::vector<TransformVar::Bin>& bins, double number) {
  for (std::size_t i = 0; i < bins.size(); ++i) {
    if (bins[i].range->IsInRange(number)) return static_cast<double>(i + 1);
  }
  return 0;
}

void CompareBins(const TransformVar& field, const std::vector<double>& ends) {
  const DictVar source("x", ScoreDictVar::kNUMERIC_VAR);
  const std::unique_ptr<TransformVar> computing(field.Clone());
  for (const double number : Neighbours(ends)) {
    const NumericValue value(number);
    const double found = computing->GetBinningValue(&source, &value)->GetDouble();
    ASSERT_EQ(found == kSysmis ? 0 : found, Walk(field.GetBins(), number)) << number;
  }
}

TEST(BinSearch, FindsWhatAWalkFindsInNeighbouringBins) {
  std::mt19937 random(1);
  for (int round = 0; round < 200; ++round) {
    const int count = 1 + static_cast<int>(random() % 40);
    std::vector<double> ends;
    double end = round % 2 == 0 ? -5.0 : 1000.0;
    for (int i = 0; i <= count; ++i) {
      ends.push_back(end);
      // Now and then bins as narrow as a tolerance.
      end += random() % 4 == 0 ? std::abs(end) * 1e-14 : (1 + random() % 8) * 0.25;
    }
    std::vector<int> order(static_cast<std::size_t>(count));
    for (int i = 0; i < count; ++i)
      order[static_cast<std::size_t>(i)] = i;
    if (round % 3 == 0) std::shuffle(order.begin(), order.end(), random);
    TransformVar field("f", ScoreDictVar::kNUMERIC_VAR);
    for (int i = 0; i < count; ++i) {
      const auto bin = static_cast<std::size_t>(order[static_cast<std::size_t>(i)]);
      if (random() % 10 == 0) continue;  // a gap
      const bool is_lowest = bin == 0 && round % 5 == 0;
      const bool is_highest = bin + 1 == static_cast<std::size_t>(count) && round % 7 == 0;
      field.AddBinningValue(
          new Range(is_lowest ? nullptr : Number(ends[bin]), is_highest ? nullptr : Number(ends[bin + 1]),
                    random() % 2 == 0, random() % 2 == 0),
          nullptr);
    }
    TransformVar numbered("f", ScoreDictVar::kNUMERIC_VAR);
    for (std::size_t i = 0; i < field.GetBins().size(); ++i)
      numbered.AddBinningValue(field.GetBins()[i].range->Clone(), Number(static_cast<double>(i + 1)));
    CompareBins(numbered, ends);
  }
}

TEST(BinSearch, FindsWhatAWalkFindsInBinsThatOverlap) {
  std::mt19937 random(2);
  for (int round = 0; round < 100; ++round) {
    TransformVar field("f", ScoreDictVar::kNUMERIC_VAR);
    std::vector<double> ends;
    for (int i = 0; i < 12; ++i) {
      const double low = random() % 10, high = low + random() % 5 - 1.0;
      ends.push_back(low);
      ends.push_back(high);
      field.AddBinningValue(new Range(low, high, random() % 2 == 0, random() % 2 == 0), Number(i + 1));
    }
    CompareBins(field, ends);
  }
}

TEST(EncodingSearch, FindsTheFirstOfNumbersThatAreNearlyEqual) {
  std::mt19937 random(3);
  const DictVar source("x", ScoreDictVar::kNUMERIC_VAR);
  for (const int count : {1, 3, 5, 17, 60}) {
    TransformVar field("f", ScoreDictVar::kNUMERIC_VAR);
    std::vector<double> listed;
    for (int i = 0; i < count; ++i) {
      const double around = random() % 6;
      listed.push_back(around * (1 + (static_cast<double>(random() % 7) - 3) * 0.4 * NumericValue::fEpsilon));
      field.AddEncodingMap(Is(Number(listed.back())), Number(i + 1));
    }
    for (const double number : Neighbours(listed)) {
      const NumericValue value(number);
      double wanted = 0;
      for (std::size_t i = 0; i < listed.size() && wanted == 0; ++i) {
        if (NumericValue::IsEqual(listed[i], number)) wanted = static_cast<double>(i + 1);
      }
      const double found = field.GetEncodedValue(&source, &value)->GetDouble();
      ASSERT_EQ(found == kSysmis ? 0 : found, wanted) << number;
    }
  }
}

/// The road of a dictionary, which gives the texts of a field codes for all that read it.
TEST(EncodingSearch, FindsTextsForManyFieldsOfOneSource) {
  std::mt19937 random(4);
  Data data;
  TransformationDictionary dictionary;
  const auto text = [](int number) { return "text" + std::to_string(number); };
  constexpr int kFields = 6, kTexts = 400;
  std::vector<std::vector<int>> listed(kFields);
  for (int i = 0; i < kFields; ++i) {
    TransformVar* const field = NewField("f" + std::to_string(i), "t", TransExpression::kMapValues);
    // From one row, which stands alone against many codes, to some hundred.
    for (int row = 0; row < 1 + i * i * 10; ++row) {
      listed[static_cast<std::size_t>(i)].push_back(static_cast<int>(random() % kTexts));
      field->AddEncodingMap(
          Is(Text(text(listed[static_cast<std::size_t>(i)].back()) + (row % 3 == 0 ? "  " : ""))),
          Number(row + 1));
    }
    AddDerived(dictionary, field);
  }
  dictionary.SetUpDerivedCaseRecord();
  for (int number = 0; number < kTexts + 5; ++number) {
    data.record.SetValue("t", text(number) + (number % 2 == 0 ? " " : ""));
    const CaseRecord* const derived = dictionary.GetValuesForDerivedVars(&data.record, &data.dictionary);
    for (int i = 0; i < kFields; ++i) {
      const std::vector<int>& rows = listed[static_cast<std::size_t>(i)];
      double wanted = kSysmis;
      for (std::size_t row = rows.size(); row-- > 0;) {
        if (rows[row] == number) wanted = static_cast<double>(row + 1);
      }
      ASSERT_EQ(derived->Get(i)->GetDouble(), wanted) << number;
    }
  }
}

}  // namespace
