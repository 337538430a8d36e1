// Large dictionaries: twice the document takes about twice the time, whatever it is made of.

#include <gtest/gtest.h>

#include <algorithm>
#include <ctime>
#include <limits>
#include <memory>
#include <string>

#include "kestrel/dictionary/ScoreEncoder.h"
#include "kestrel/dictionary/ScoreMissingValueSet.h"
#include "kestrel/dictionary/ScoreValueLabelSet.h"
#include "kestrel/foundation/KestrelException.h"
#include "tests/support/DictionaryText.h"

namespace {

using kestrel_test::DictionaryOf;
using kestrel_test::DictionaryTranslator;
using kestrel_test::ReadDictionary;
using kestrel_test::ReadTree;
using MCKestrel_800::ScoreDictionary;

/// 0, 1, ... n - 1 out of order.
size_t Shuffled(size_t i, size_t n) {
  return i * 7919 % n;
}

std::string Fields(size_t n) {
  std::string fields;
  for (size_t i = 0; i < n; ++i) {
    fields += "<DataField name='field_" + std::to_string(Shuffled(i, n)) +
              "' optype='categorical' dataType='string'><Value value='a'/><Value value='b'/></DataField>";
  }
  return DictionaryOf(static_cast<int>(n), fields);
}

std::string OneField(const std::string& attributes, const std::string& values) {
  return DictionaryOf(1, "<DataField name='x' " + attributes + ">" + values + "</DataField>");
}

std::string TextCategories(size_t n) {
  std::string values;
  for (size_t i = 0; i < n; ++i)
    values += "<Value value='category " + std::to_string(Shuffled(i, n)) + "'/>";
  return OneField("optype='categorical' dataType='string'", values);
}

std::string ExactCategories(size_t n) {
  std::string values = "<Extension name='noSpaceTrim' value='true'/>";
  for (size_t i = 0; i < n; ++i)
    values += "<Value value='" + std::to_string(Shuffled(i, n)) + " '/>";
  return OneField("optype='categorical' dataType='string'", values);
}

std::string NumberCategories(size_t n) {
  std::string values;
  for (size_t i = 0; i < n; ++i)
    values += "<Value value='" + std::to_string(Shuffled(i, n)) + ".5'/>";
  return OneField("optype='ordinal' dataType='double'", values);
}

std::string ValidAndMissing(size_t n) {
  std::string values;
  for (size_t i = 0; i < n; ++i) {
    const size_t number = Shuffled(i, n);
    values += "<Value value='" + std::to_string(number) + "' property='" +
              (number % 2 ? "missing" : "valid") + "'/>";
  }
  return OneField("optype='ordinal' dataType='integer'", values);
}

std::string ContinuousValues(size_t n) {
  std::string values;
  for (size_t i = 0; i < n; ++i) {
    const size_t number = Shuffled(i, n);
    values += "<Value value='" + std::to_string(number) + "' property='" +
              (number % 2 ? "missing" : "valid") + "'/>";
  }
  return OneField("optype='continuous' dataType='double'", values);
}

std::string ProducersIntervals(size_t n) {
  std::string intervals;
  for (size_t i = 0; i < n; ++i) {
    const std::string left = std::to_string(Shuffled(i, n));
    intervals +=
        "<X-DataField><Interval leftMargin='" + left + "' rightMargin='" + left + ".5'/></X-DataField>";
  }
  return OneField("optype='continuous' dataType='double'", intervals);
}

std::string Extensions(size_t n) {
  std::string extensions;
  for (size_t i = 0; i < n; ++i)
    extensions += "<Extension name='width' value='" + std::to_string(i) + "'/>";
  return OneField("optype='continuous' dataType='double'", extensions);
}

/// The least processor time, in seconds, that building the dictionary took in several goes.
double TimeOf(const std::string& document) {
  const auto tree = ReadTree(document);
  DictionaryTranslator translator;
  double least = std::numeric_limits<double>::infinity();
  for (int go = 0; go < 5; ++go) {
    const std::clock_t start = std::clock();
    const std::unique_ptr<ScoreDictionary> dictionary(translator.ParseDictionary(tree->GetRoot(), false));
    least = std::min(least, static_cast<double>(std::clock() - start) / CLOCKS_PER_SEC);
  }
  return least;
}

struct GrowthRow {
  const char* why;
  std::string (*make)(size_t n);
};

constexpr GrowthRow kGrowth[] = {
    {"fields", Fields},
    {"text categories", TextCategories},
    {"exact text categories", ExactCategories},
    {"number categories", NumberCategories},
    {"valid and missing categories", ValidAndMissing},
    {"valid and missing numbers", ContinuousValues},
    {"producers' intervals", ProducersIntervals},
    {"extensions", Extensions},
};

TEST(PMMLTranslatorScale, GrowsWithTheDocument) {
  // Twice as much of something quadratic takes four times as long; sorting and memory cost a little over two.
  constexpr double kMostGrowth = 3.0;
  constexpr size_t kCount = 10000;
  for (const GrowthRow& row : kGrowth) {
    double growth = kMostGrowth + 1;
    // The machine may be busy with something else: a quadratic reader fails every time.
    for (int go = 0; go < 3 && growth > kMostGrowth; ++go) {
      growth = TimeOf(row.make(2 * kCount)) / TimeOf(row.make(kCount));
    }
    EXPECT_LE(growth, kMostGrowth) << row.why;
  }
}

TEST(PMMLTranslatorScale, HoldsManyCategories) {
  constexpr int kCount = 100000;
  const auto dictionary = ReadDictionary(TextCategories(kCount));
  const MCKestrel_800::ScoreDictVar* variable = dictionary->GetVar("x");
  EXPECT_EQ(variable->GetNumberOfCats(), kCount);
  EXPECT_EQ(variable->GetEncoder()->GetNumberOfCategories(), kCount);
  EXPECT_EQ(variable->GetEncoder()->EncodeConst(std::string("category 7919")), 1);
}

TEST(PMMLTranslatorScale, FindsADuplicateAmongMany) {
  std::string document = NumberCategories(20000);
  document.insert(document.rfind("</DataField>"), "<Value value='777.50'/>");
  try {
    ReadDictionary(document);
    FAIL() << "the duplicate was not found";
  } catch (const MCKestrel_800::KestrelException& fault) {
    EXPECT_EQ(fault.GetErrorCode(), 1);
    EXPECT_EQ(fault.GetErrorMessage(), "\"777.5\": Duplicated Category Value!");
  }
}

}  // namespace
