// Loads and scores models on several threads at once. A program of its own, so that these loads are the first
// thing that the process does with the parser and with the libraries.

#include <gtest/gtest.h>

#include <atomic>
#include <memory>
#include <sstream>
#include <string>
#include <thread>
#include <vector>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/model/Results.h"
#include "kestrel/model/ScoreModel.h"
#include "tests/support/TempFolder.h"

namespace {

using namespace MCKestrel_800;

constexpr int kThreads = 8;
constexpr int kLoads = 60;
constexpr int kCases = 100;

struct Files {
  std::string model;
  std::string names;
  std::string other_names;
};

/// The loads of one thread: every road into the factory in turn.
ScoreModel* Load(int turn, const Files& files) {
  const std::string text = "<PMML><TreeModel/><RegressionModel/></PMML>";
  std::istringstream in(text);
  switch (turn % 5) {
    case 0:
      return ModelFactory::MakeModelFromXML(in, {"RegressionModel"}, "x");
    case 1:
      return ModelFactory::MakeModelFromXML(files.model, files.names, "x");
    case 2:
      return ModelFactory::MakeModelFromXML(files.model, files.other_names, "x", "y");
    case 3:
      return ModelFactory::MakeModelFromXML(in, ModelFactory::fModelNames, "x");
    default:
      EXPECT_THROW(ModelFactory::MakeModelFromXML(in, {"Absent"}, "x"), KestrelException);
      return nullptr;
  }
}

bool ScoresAsItShould(ScoreModel& model) {
  const std::unique_ptr<ScoreResult> result(model.MakeResult());
  for (int i = 0; i < kCases; ++i) {
    if (!model.Score(nullptr, result.get()).IsOK()) return false;
    if (result->GetPrediction()->GetDouble() != 42.0) return false;
  }
  return true;
}

TEST(FactoryThreads, LoadAndScoreAtOnce) {
  const kestrel_tests::TempFolder folder;
  const Files files = {folder.Write("model.xml", "<PMML><TreeModel/><RegressionModel/></PMML>"),
                       folder.Write("names.txt", "TreeModel RegressionModel"),
                       folder.Write("other.txt", "Absent\nRegressionModel\nTreeModel\nNeuralNetwork")};
  // Loads that use the factory's own list find it filled from the start.
  ModelFactory::fModelNames = {"TreeModel"};
  std::atomic<int> models{0};
  std::atomic<int> wrong{0};
  std::vector<std::thread> threads;
  for (int t = 0; t < kThreads; ++t) {
    threads.emplace_back([t, &files, &models, &wrong] {
      for (int i = 0; i < kLoads; ++i) {
        const std::unique_ptr<ScoreModel> model(Load(t + i, files));
        if (model == nullptr) continue;
        ++models;
        if (!ScoresAsItShould(*model)) ++wrong;
      }
    });
  }
  for (std::thread& thread : threads)
    thread.join();
  EXPECT_EQ(wrong, 0);
  EXPECT_EQ(models, kThreads * kLoads * 4 / 5);
}

TEST(FactoryThreads, ToldWhyOnTheThreadThatFailed) {
  std::istringstream in("<PMML><NoSuchModel/></PMML>");
  EXPECT_THROW(ModelFactory::MakeModelFromXML(in, {"NoSuchModel"}, ""), KestrelException);
  EXPECT_NE(ModelFactory::GetLastLoadError(), "");
  std::thread([] { EXPECT_EQ(ModelFactory::GetLastLoadError(), ""); }).join();
}

}  // namespace
