// Random documents with derived fields against the answers of an evaluator of its own: tests/data/derived,
// which was written from the description of the language and knows nothing of this library.

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <map>
#include <memory>
#include <sstream>
#include <string>
#include <thread>
#include <vector>

#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/NumberText.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/TransformationDictionary.h"
#include "tests/transform/RandomDocuments.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

// Exponentials, logarithms and normal distributions come from different libraries, and powers and sums of
// squares multiply in different orders; the cases are chosen so that this costs less. All other arithmetic is
// the same to the last bit.
constexpr double kTolerance = 1e-12;

/// What a derived field was, to be compared with a cell or with another answer.
struct Answer {
  ScoreValue::ValueType type = ScoreValue::kNumeric;
  double number = 0.0;
  std::string text;

  explicit Answer(const ScoreValue& value) : type(value.GetType()) {
    if (type == ScoreValue::kString) {
      text = value.GetString();
    } else {
      number = value.GetDouble();
    }
  }
  bool operator==(const Answer& other) const {
    return type == other.type && number == other.number && text == other.text;
  }
};

std::ostream& operator<<(std::ostream& os, const Answer& answer) {
  if (answer.type == ScoreValue::kString) return os << '"' << answer.text << '"';
  if (NumericValue::IsSystemMissingValue(answer.number)) return os << "missing";
  return os << std::string(answer.type == ScoreValue::kDateTime ? "@" : "")
            << testing::PrintToString(answer.number);
}

using Answers = std::vector<Answer>;

double NumberOfCell(const std::string& cell) {
  if (cell == ".") return NumericValue::gSysmisValue;
  const size_t begin = cell[0] == '@' ? 1 : 0;
  double number = 0.0;
  EXPECT_TRUE(ParseDouble(cell.data() + begin, cell.data() + cell.size(), number)) << cell;
  return number;
}

/// Whether an answer is what a cell says.
bool Agrees(const std::string& cell, const Answer& answer) {
  if (cell[0] == '"') return answer.type == ScoreValue::kString && answer.text == UnescapedText(cell);
  if (answer.type == ScoreValue::kString) return false;
  if (cell != "." && (cell[0] == '@') != (answer.type == ScoreValue::kDateTime)) return false;
  const double wanted = NumberOfCell(cell);
  if (wanted == NumericValue::gSysmisValue || answer.number == NumericValue::gSysmisValue) {
    return wanted == answer.number;
  }
  return std::fabs(wanted - answer.number) <=
         kTolerance * std::max(std::fabs(wanted), std::fabs(answer.number));
}

/// One document, loaded.
class LoadedDocument {
 public:
  explicit LoadedDocument(const RandomDocument& source) : source_(source) {
    std::istringstream in(source.text);
    ScoreDictionary* data = nullptr;
    derived_.reset(ModelFactory::GetTransformationDictionaryFromXML(in, data, std::string()));
    data_.reset(data);
    derived_->SetUpDerivedCaseRecord();
    for (size_t row = 0; row < source.cases.size(); ++row)
      records_.push_back(MakeRecord(source.cases[row]));
  }

  const RandomDocument& Source() const { return source_; }
  TransformationDictionary& Derived() { return *derived_; }
  size_t Cases() const { return records_.size(); }

  /// All fields of a case, by a dictionary that may be a copy.
  Answers Compute(TransformationDictionary& derived, size_t row) const {
    const CaseRecord* values = derived.GetValuesForDerivedVars(records_[row].get(), data_.get());
    Answers answers;
    for (const std::string& name : source_.derived)
      answers.emplace_back(*values->Get(name));
    return answers;
  }

  /// One field of a case, by itself.
  Answer ComputeField(const std::string& name, size_t row) {
    auto* field = dynamic_cast<TransformVar*>(derived_->GetVar(name));
    return Answer(*field->GetTransformedValue(records_[row].get(), data_.get(), derived_.get()));
  }

  std::string Where(size_t row, size_t field) const {
    return source_.title + ", case " + std::to_string(row + 1) + ", " + source_.derived[field];
  }

 private:
  /// Absent values are left out of every other case and stand as null values in the others.
  std::unique_ptr<CaseRecord> MakeRecord(const std::vector<std::string>& cells) const {
    auto record = std::make_unique<CaseRecord>(static_cast<int>(cells.size()));
    for (size_t i = 0; i < cells.size(); ++i) {
      if (!cells[i].empty()) {
        record->Add(source_.given[i], MakeValue(source_.given[i], cells[i]));
      } else if (records_.size() % 2 == 0) {
        record->Add(source_.given[i], nullptr);
      }
    }
    return record;
  }

  ScoreValue* MakeValue(const std::string& name, const std::string& cell) const {
    const ScoreDictVar* variable = data_->GetVar(name);
    if (variable == nullptr) variable = derived_->GetVar(name);
    if (cell[0] == '"') return new StringValue(UnescapedText(cell));
    if (variable->GetVarType() != ScoreDictVar::kDATETIME_VAR) return new NumericValue(NumberOfCell(cell));
    return new DateTimeValue(NumberOfCell(cell), DateTimeValue::GetValType(variable->GetDateTimeType()));
  }

  RandomDocument source_;
  std::unique_ptr<ScoreDictionary> data_;
  std::unique_ptr<TransformationDictionary> derived_;
  std::vector<std::unique_ptr<CaseRecord>> records_;
};

/// A test of its own may name another file.
std::string PathOfDocuments() {
  const char* other = std::getenv("KESTREL_RANDOM_DOCUMENTS");
  return other != nullptr ? other : std::string(KESTREL_SOURCE_DIR) + "/tests/data/derived/random.txt";
}

class RandomDocuments : public testing::Test {
 protected:
  static void SetUpTestSuite() {
    documents_ = new std::vector<std::unique_ptr<LoadedDocument>>;
    for (const RandomDocument& document : ReadRandomDocuments(PathOfDocuments())) {
      try {
        documents_->push_back(std::make_unique<LoadedDocument>(document));
      } catch (const KestrelException& refusal) {
        ADD_FAILURE() << document.title << ": " << refusal.GetErrorMessage();
      }
    }
  }
  static void TearDownTestSuite() {
    delete documents_;
    documents_ = nullptr;
  }

  static std::vector<std::unique_ptr<LoadedDocument>>& Documents() { return *documents_; }

  /// The answers of all cases by a dictionary, asked from the last to the first if so wanted.
  static std::vector<Answers> ComputeAll(const LoadedDocument& document, TransformationDictionary& derived,
                                         bool backwards = false) {
    std::vector<Answers> all(document.Cases());
    for (size_t i = 0; i < all.size(); ++i) {
      const size_t row = backwards ? all.size() - 1 - i : i;
      all[row] = document.Compute(derived, row);
    }
    return all;
  }

 private:
  static std::vector<std::unique_ptr<LoadedDocument>>* documents_;
};

std::vector<std::unique_ptr<LoadedDocument>>* RandomDocuments::documents_ = nullptr;

TEST_F(RandomDocuments, GiveWhatTheEvaluatorGives) {
  size_t cases = 0, values = 0, present = 0;
  for (auto& document : Documents()) {
    for (size_t row = 0; row < document->Cases(); ++row) {
      const Answers answers = document->Compute(document->Derived(), row);
      for (size_t field = 0; field < answers.size(); ++field) {
        const std::string& wanted = document->Source().answers[row][field];
        EXPECT_TRUE(Agrees(wanted, answers[field]))
            << document->Where(row, field) << " is " << answers[field] << ", not " << wanted;
        ++values;
        present += wanted != "." && wanted != "\"" ? 1 : 0;
      }
      ++cases;
    }
  }
  // Enough of all, or the comparison is worth little.
  EXPECT_GE(cases, 2000u);
  EXPECT_GE(values, 15000u);
  EXPECT_GE(present, values / 2);
}

TEST_F(RandomDocuments, GiveTheSameFieldByField) {
  for (auto& document : Documents()) {
    for (size_t row = 0; row < document->Cases(); ++row) {
      // From the last, so that what a field depends on was not asked for before.
      for (size_t field = document->Source().derived.size(); field-- > 0;) {
        const Answer answer = document->ComputeField(document->Source().derived[field], row);
        const std::string& wanted = document->Source().answers[row][field];
        EXPECT_TRUE(Agrees(wanted, answer))
            << document->Where(row, field) << " is " << answer << ", not " << wanted;
      }
    }
  }
}

TEST_F(RandomDocuments, RememberNothingOfTheCaseBefore) {
  for (auto& document : Documents()) {
    const std::vector<Answers> forwards = ComputeAll(*document, document->Derived());
    EXPECT_EQ(ComputeAll(*document, document->Derived(), true), forwards) << document->Source().title;
  }
}

TEST_F(RandomDocuments, GiveTheSameByACopy) {
  for (auto& document : Documents()) {
    const std::vector<Answers> answers = ComputeAll(*document, document->Derived());
    const std::unique_ptr<TransformationDictionary> copy(document->Derived().Clone());
    EXPECT_EQ(ComputeAll(*document, *copy), answers) << document->Source().title;
  }
}

TEST_F(RandomDocuments, GiveTheSameInTwoThreads) {
  for (auto& document : Documents()) {
    const std::vector<Answers> wanted = ComputeAll(*document, document->Derived());
    const std::unique_ptr<TransformationDictionary> first(document->Derived().Clone());
    const std::unique_ptr<TransformationDictionary> second(document->Derived().Clone());
    std::vector<Answers> forwards, backwards;
    std::thread thread([&] { forwards = ComputeAll(*document, *first); });
    backwards = ComputeAll(*document, *second, true);
    thread.join();
    EXPECT_EQ(forwards, wanted) << document->Source().title;
    EXPECT_EQ(backwards, wanted) << document->Source().title;
  }
}

}  // namespace
}  // namespace kestrel_tests
