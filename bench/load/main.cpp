// How long a document takes from bytes to model, against the stock parser's bare tree of the same bytes.

#include <malloc.h>
#include <sys/resource.h>

#include <cstdlib>
#include <cstring>
#include <memory>
#include <sstream>
#include <xercesc/framework/MemBufInputSource.hpp>
#include <xercesc/parsers/XercesDOMParser.hpp>
#include <xercesc/util/PlatformUtils.hpp>

#include "bench/load/DerivedDocuments.h"
#include "bench/support/Documents.h"
#include "bench/support/Interleaved.h"
#include "bench/support/PredicateDocuments.h"
#include "bench/support/TreeDocuments.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/model/ScoreModel.h"
#include "kestrel/predicates/ScorePredicate.h"
#include "kestrel/transform/TransformationDictionary.h"
#include "kestrel/translate/DocumentReader.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/XmlText.h"

namespace kestrel_bench {
namespace {

using MCKestrel_800::ModelFactory;
using MCKestrel_800::PMMLTranslator;
using MCKestrel_800::ScoreDictionary;
using MCKestrel_800::ScoreModel;
using MCKestrel_800::ScorePredicate;
using MCKestrel_800::TransformationDictionary;

[[noreturn]] void Fail(const char* what) {
  std::fprintf(stderr, "bench_load: %s\n", what);
  std::exit(1);
}

/// The baseline: the parser as it comes, building and releasing its tree.
void ParseWithStockParser(const std::string& document) {
  xercesc::XercesDOMParser parser;
  parser.setLoadExternalDTD(false);
  parser.setValidationScheme(xercesc::XercesDOMParser::Val_Never);
  xercesc::MemBufInputSource source(reinterpret_cast<const XMLByte*>(document.data()), document.size(),
                                    "memory");
  parser.parse(source);
  if (parser.getErrorCount() != 0 || parser.getDocument() == nullptr)
    Fail("the stock parser refused a document");
}

/// A document's dictionaries.
struct ReadFields {
  std::unique_ptr<ScoreDictionary> dictionary;
  std::unique_ptr<TransformationDictionary> derived;
};

ReadFields LoadFields(const std::string& document) {
  std::istringstream in(document);
  ReadFields fields;
  ScoreDictionary* dictionary = nullptr;
  fields.derived.reset(ModelFactory::GetTransformationDictionaryFromXML(in, dictionary, std::string()));
  fields.dictionary.reset(dictionary);
  if (fields.derived->Size() == 0) Fail("a document gave no derived fields");
  return fields;
}

std::unique_ptr<ScoreModel> Load(const std::string& document) {
  std::istringstream in(document);
  std::unique_ptr<ScoreModel> model(
      ModelFactory::MakeModelFromXML(in, {"RegressionModel", "TreeModel"}, std::string()));
  if (model == nullptr || model->GetPredictors().empty()) Fail("a document gave no model");
  return model;
}

double Megabytes(size_t bytes) {
  return static_cast<double>(bytes) / 1e6;
}

/// Times the load of a document. Returns the bytes that the model keeps.
size_t CompareLoads(const char* title, const std::string& document, int repeat) {
  std::unique_ptr<ScoreModel> model;
  const size_t before = mallinfo2().uordblks;
  model = Load(document);
  const size_t kept = mallinfo2().uordblks - before;
  model.reset();
  const std::vector<Contestant> contestants = {
      {"stock parser: parse and release",
       [&] {
         for (int i = 0; i < repeat; ++i)
           ParseWithStockParser(document);
       }},
      {"our reader: parse and release",
       [&] {
         for (int i = 0; i < repeat; ++i) {
           std::istringstream in(document);
           if (MCKestrel_800::ReadDocument(in) == nullptr) Fail("our reader refused a document");
         }
       }},
      {"whole load: bytes to model",
       [&] {
         for (int i = 0; i < repeat; ++i)
           model = Load(document);
       },
       [&] { model.reset(); }},
  };
  std::printf("%s, %.3f MB%s\n", title, Megabytes(document.size()),
              repeat > 1 ? (", " + std::to_string(repeat) + " times a turn").c_str() : "");
  const std::vector<double> seconds = Compare(contestants);
  PrintRatios(contestants, seconds);
  std::printf("  %-46s %10.2f us\n", "one whole load", 1e6 * seconds[2] / repeat);
  std::printf("  %-46s %10.3f MB\n", "memory that the model keeps", Megabytes(kept));
  return kept;
}

/// The same for derived fields, which are read and let go of.
void CompareFieldLoads(const char* title, const std::string& document) {
  ReadFields fields;
  const std::vector<Contestant> contestants = {
      {"stock parser: parse and release", [&] { ParseWithStockParser(document); }},
      {"our reader: parse and release",
       [&] {
         std::istringstream in(document);
         if (MCKestrel_800::ReadDocument(in) == nullptr) Fail("our reader refused a document");
       }},
      {"whole load: bytes to fields", [&] { fields = LoadFields(document); }, [&] { fields = {}; }},
      {"the same, fields deleted", [&] { LoadFields(document); }},
  };
  std::printf("%s, %.3f MB\n", title, Megabytes(document.size()));
  PrintRatios(contestants, Compare(contestants));
}

/// The same for a tree: with identifiers and, for a classification, distributions of three categories, all of
/// which are kept.
void CompareTreeLoads(const char* title, int depth, const TreeShape& shape) {
  constexpr int kInputs = 30;
  const PlainTree tree = RandomTree(kInputs, depth, 20);
  const size_t kept = CompareLoads(title, TreeDocument(tree, kInputs, shape), 1);
  size_t strings = 0;
  for (size_t node = 0; node < tree.nodes.size(); ++node)
    strings += std::to_string(node).size();
  const size_t distributions = tree.nodes.size() * static_cast<size_t>(shape.categories) * 32;
  std::printf("  %-46s %10.1f bytes\n", "a node, beside identifiers and distributions",
              static_cast<double>(kept - strings - distributions) / static_cast<double>(tree.nodes.size()));
}

/// A dictionary and the predicate on it, as a plug-in reads them.
struct ReadRule {
  std::unique_ptr<ScoreDictionary> dictionary;
  std::unique_ptr<ScorePredicate> predicate;
};

ReadRule LoadRule(const std::string& document) {
  class Translator : public PMMLTranslator {
   public:
    using PMMLTranslator::ParseFromTree;
    ScoreModel* ParseFromTree(xercesc::DOMElement*, const std::string&) override { return nullptr; }
  };
  std::istringstream in(document);
  const auto tree = MCKestrel_800::ReadDocument(in);
  xercesc::DOMElement* const first = MCKestrel_800::FirstChild(tree->GetRoot());
  xercesc::DOMElement* const second = MCKestrel_800::NextSibling(first);
  ReadRule rule;
  rule.dictionary.reset(Translator().ParseDictionary(first, false));
  const bool isSet = MCKestrel_800::ElementIs(second, u"SimpleSetPredicate");
  rule.predicate.reset(
      isSet ? PMMLTranslator::ParseSetPredicate(second, rule.dictionary.get(), nullptr)
            : PMMLTranslator::ParseCompoundPredicate(second, rule.dictionary.get(), nullptr, false));
  if (rule.predicate == nullptr) Fail("a document gave no predicate");
  return rule;
}

/// How the time grows from a document to one twice as long.
template <typename LoadOne>
void CompareSizes(const GrowthShape& shape, size_t n, LoadOne load) {
  const std::string once = shape.make(n);
  const std::string twice = shape.make(2 * n);
  decltype(load(once)) loaded = {};
  const std::vector<Contestant> contestants = {
      {"n", [&] { loaded = load(once); }, [&] { loaded = {}; }},
      {"2n", [&] { loaded = load(twice); }, [&] { loaded = {}; }},
  };
  const std::vector<double> seconds = Compare(contestants);
  std::printf("  %-46s %10.6f s  %6.2f x\n", shape.name, seconds[0], seconds[1] / seconds[0]);
}

/// The smallest document of a shape that has at least that many bytes.
template <typename Make>
std::string OfSize(size_t bytes, Make make) {
  const size_t sample = 1000;
  const double each = static_cast<double>(make(2 * sample).size() - make(sample).size()) / sample;
  return make(1 + static_cast<size_t>(static_cast<double>(bytes) / each));
}

int Run(bool smoke) {
  xercesc::XMLPlatformUtils::Initialize();
  const size_t large = smoke ? 200'000 : 20'000'000;
  const size_t many = smoke ? 500 : 10'000;
  CompareLoads("regression document", OfSize(large, [](size_t n) { return ClassificationModel(n, 20); }), 1);
  CompareLoads("dictionary document", OfSize(large, DictionaryModel), 1);
  CompareTreeLoads("regression tree document", smoke ? 10 : 16, {});
  CompareTreeLoads("classification tree document", smoke ? 10 : 15, {3, true});
  CompareFieldLoads("table document (text to number)", OfSize(large, TableDocument));
  CompareFieldLoads("table document (text to category)", OfSize(large, CategoryTableDocument));
  CompareLoads("small regression document (20 inputs)", LinearModel(20, false), smoke ? 10 : 500);
  std::printf("growth: t(2n) / t(n), n = %zu\n", many);
  for (const GrowthShape& shape : GrowthShapes())
    CompareSizes(shape, many, Load);
  for (const GrowthShape& shape : PredicateShapes())
    CompareSizes(shape, many, LoadRule);
  for (const GrowthShape& shape : DerivedShapes())
    CompareSizes(shape, many, LoadFields);
  return 0;
}

}  // namespace
}  // namespace kestrel_bench

int main(int argc, char** argv) {
  return kestrel_bench::Run(argc > 1 && std::strcmp(argv[1], "--smoke") == 0);
}
