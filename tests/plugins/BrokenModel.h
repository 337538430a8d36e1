// Loads a document that may be broken and scores with what comes of it.

#ifndef KESTREL_TESTS_PLUGINS_BROKENMODEL_H
#define KESTREL_TESTS_PLUGINS_BROKENMODEL_H

#include <gtest/gtest.h>

#include <exception>
#include <fstream>
#include <memory>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/model/Results.h"
#include "kestrel/model/ScoreModel.h"

namespace kestrel_tests {

inline constexpr char kOrders[] = "tests/data/broken/orders.xml";
inline constexpr char kTitanic[] = "examples/titanic/model.xml";
inline constexpr char kIris[] = "examples/iris/model.xml";
inline constexpr char kHousing[] = "examples/housing/model.xml";

using Cells = std::vector<std::pair<std::string, std::string>>;

/// A document with a case that its model scores.
struct Sample {
  const char* name;
  const char* path;
  Cells cells;
  std::string prediction;
};

inline void PrintTo(const Sample& sample, std::ostream* out) {
  *out << sample.name;
}

inline std::vector<Sample> Samples() {
  return {
      // 12.5 + 0.25 * 30^2 + 0.0015 * 1000 - 0.001 * 2000 + 3 + 10 + 7 + 0.0625 * 30 * 1000
      {"orders",
       kOrders,
       {{"age", "30"},
        {"income", "1000"},
        {"town", "Rome"},
        {"member", "yes"},
        {"rating", "3"},
        {"since", "2000"}},
       "2132"},
      {"titanic", kTitanic, {{"Class", "1st"}, {"Sex", "Female"}, {"Age", "Adult"}}, "Yes"},
      {"iris",
       kIris,
       {{"sepal_length", "5.1"}, {"sepal_width", "3.5"}, {"petal_length", "1.4"}, {"petal_width", "0.2"}},
       "setosa"},
  };
}

inline std::string DocumentText(const std::string& path) {
  std::ifstream in(std::string(KESTREL_SOURCE_DIR) + "/" + path, std::ios::binary);
  std::ostringstream text;
  text << in.rdbuf();
  return text.str();
}

inline std::string Replaced(std::string text, const std::string& what, const std::string& with) {
  const size_t at = text.find(what);
  EXPECT_NE(at, std::string::npos) << what;
  return at == std::string::npos ? text : text.replace(at, what.size(), with);
}

inline std::unique_ptr<MCKestrel_800::ScoreModel> Load(const std::string& document) {
  std::istringstream in(document);
  return std::unique_ptr<MCKestrel_800::ScoreModel>(
      MCKestrel_800::ModelFactory::MakeModelFromXML(in, {"RegressionModel"}, std::string()));
}

/// A cell as a host makes it: of the type that the model's dictionary gives the field, which a broken
/// document may have changed.
inline MCKestrel_800::ScoreValue* MakeValue(const MCKestrel_800::ScoreModel& model, const std::string& name,
                                            const std::string& cell) {
  const MCKestrel_800::ScoreDictVar* variable = model.GetDictionary()->GetVar(name);
  if (variable != nullptr && variable->GetVarType() == MCKestrel_800::ScoreDictVar::STRING_VAR)
    return new MCKestrel_800::StringValue(cell);
  return new MCKestrel_800::NumericValue(cell);
}

/// Scores a case and returns the prediction; "-" when there is none. What comes back must fit together.
inline std::string ScoreCase(MCKestrel_800::ScoreModel& model, const MCKestrel_800::ScoreCaseRecord& record,
                             const std::string& why) {
  const std::unique_ptr<MCKestrel_800::ScoreResult> result(model.MakeResult());
  const MCScore::MCStatus status = model.Score(&record, result.get());
  const MCKestrel_800::ScoreValue* prediction = result->GetPrediction();
  EXPECT_EQ(status.IsOK(), prediction != nullptr) << why;
  if (!status.IsOK()) {
    EXPECT_TRUE(status.IsError()) << why;
    EXPECT_TRUE(status.GetErrorCode() == 90025 || status.GetErrorCode() == 90027)
        << why << ": " << status.GetErrorCode();
  }
  return prediction != nullptr ? prediction->GetString() : "-";
}

/// Uses the model as hosts do: a full case, one without any value, one of values that fit nothing.
inline std::string UseModel(MCKestrel_800::ScoreModel& model, const Cells& cells, const std::string& why) {
  MCKestrel_800::CaseRecord full(static_cast<int>(cells.size()));
  MCKestrel_800::CaseRecord odd(static_cast<int>(cells.size()));
  for (const auto& [name, cell] : cells) {
    full.Add(name, MakeValue(model, name, cell));
    odd.Add(name, new MCKestrel_800::StringValue("odd"));
  }
  ScoreCase(model, MCKestrel_800::CaseRecord(0), why);
  ScoreCase(model, odd, why);
  std::ostringstream shown;
  model.Display(shown);
  EXPECT_FALSE(shown.str().empty()) << why;
  for (const MCKestrel_800::ScoreDictVar* predictor : model.GetPredictors())
    EXPECT_NE(predictor, nullptr) << why;
  return ScoreCase(model, full, why);
}

constexpr int kLoaded = 0;    // the document gave a model
constexpr int kEscaped = -1;  // something other than our exception came out

struct Outcome {
  int code = kLoaded;
  std::string text;  ///< the message, or the prediction
  unsigned line = 0;
  unsigned column = 0;
};

inline Outcome LoadAndScore(const std::string& document, const Cells& cells, const std::string& why) {
  try {
    const std::unique_ptr<MCKestrel_800::ScoreModel> model = Load(document);
    if (model == nullptr) return {kEscaped, "no model"};
    return {kLoaded, UseModel(*model, cells, why)};
  } catch (const MCKestrel_800::KestrelException& fault) {
    return {fault.GetErrorCode(), fault.GetErrorMessage(), fault.GetLine(), fault.GetColumn()};
  } catch (const std::exception& other) {
    return {kEscaped, other.what()};
  } catch (...) {
    return {kEscaped, "an exception of an unknown kind"};
  }
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_PLUGINS_BROKENMODEL_H
