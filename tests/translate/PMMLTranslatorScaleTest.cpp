// Large dictionaries, whatever they are made of. How the time grows is measured by bench/load; here a reader
// that grows with the square of anything would not end in reasonable time.

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
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

struct LargeRow {
  const char* why;
  std::string (*make)(size_t n);
};

constexpr LargeRow kLarge[] = {
    {"fields", Fields},
    {"text categories", TextCategories},
    {"exact text categories", ExactCategories},
    {"number categories", NumberCategories},
    {"valid and missing categories", ValidAndMissing},
    {"valid and missing numbers", ContinuousValues},
    {"producers' intervals", ProducersIntervals},
    {"extensions", Extensions},
};

TEST(PMMLTranslatorScale, ReadsAHundredThousandOfEach) {
  constexpr size_t kCount = 100000;
  for (const LargeRow& row : kLarge) {
    const std::unique_ptr<ScoreDictionary> dictionary = ReadDictionary(row.make(kCount));
    ASSERT_NE(dictionary, nullptr) << row.why;
    const bool many = row.make == Fields;
    EXPECT_EQ(dictionary->Size(), many ? kCount : 1u) << row.why;
    const MCKestrel_800::ScoreDictVar* variable = dictionary->GetVar(many ? "field_77" : "x");
    ASSERT_NE(variable, nullptr) << row.why;
    const size_t filed = variable->GetValueLabels()->Size() + variable->GetMissingValues()->Size();
    EXPECT_EQ(filed, many ? 2u : row.make == Extensions ? 0u : kCount) << row.why;
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
