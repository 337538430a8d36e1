// Tests of making models from documents, with stub libraries for the models.

#include "kestrel/model/ModelFactory.h"

#include <gtest/gtest.h>

#include <fstream>
#include <functional>
#include <memory>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>
#include <xercesc/dom/DOMElement.hpp>

#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/foundation/Locale.h"
#include "kestrel/model/Results.h"
#include "kestrel/model/ScoreModel.h"
#include "kestrel/platform/SharedLibrary.h"
#include "kestrel/translate/DocumentReader.h"
#include "tests/support/ExpectFault.h"
#include "tests/support/TempFolder.h"

namespace {

using namespace MCKestrel_800;
using kestrel_tests::ExpectFault;
using kestrel_tests::TempFolder;

using Names = std::vector<std::string>;

const char kTreeDocument[] = "<PMML><TreeModel/></PMML>";

/// What a stub's model tells about the way in which it was built.
std::string StoryOf(ScoreModel* made) {
  const std::unique_ptr<ScoreModel> model(made);
  if (model == nullptr) return "no model";
  std::ostringstream out;
  model->Display(out);
  return model->GetModelKind() + ": " + out.str();
}

std::string MakeFrom(const std::string& text, const Names& names, const std::string& arg = "x") {
  std::istringstream in(text);
  return StoryOf(ModelFactory::MakeModelFromXML(in, names, arg));
}

std::string TextForNoLibrary(const std::string& tag) {
  return "Doesn't Support " + tag + "  Model: No Required dll or lib available!";
}

/// The translators of a stub library that have not been destroyed.
int LiveTranslatorsOf(const std::string& tag) {
  SharedLibrary library(SharedLibrary::WithSuffix(tag + "800r"));
  EXPECT_TRUE(library.Load()) << library.GetLastErrorText();
  auto* count = reinterpret_cast<int (*)()>(library.FindSymbol("CountLiveTranslators"));
  return count != nullptr ? count() : -1;
}

TEST(ModelFactory, GivesTheRootAndTheArgumentToTheLibraryOfTheModel) {
  struct Row {
    const char* text;
    Names names;
    const char* story;
    const char* why;
  };
  const Row rows[] = {
      {kTreeDocument, {"TreeModel"}, "TreeModel: root=PMML arg=x", "the usual way"},
      {"<PMML><RegressionModel/><TreeModel/></PMML>",
       {"TreeModel", "RegressionModel"},
       "TreeModel: root=PMML arg=x",
       "the list's order"},
      {"<PMML><RegressionModel/><TreeModel/></PMML>",
       {"RegressionModel", "TreeModel"},
       "RegressionModel: root=PMML arg=x names=RegressionModel;TreeModel;mark of the plug-in;",
       "the list's order, and a library that takes the names"},
      {"<vexa-ml><regression-model/></vexa-ml>",
       {},
       "GeneralRegressionModel: root=vexa-ml arg=x",
       "the older format needs no names"},
      {"<vexa-ml><dictionary/><TreeModel/></vexa-ml>",
       {"TreeModel"},
       "TreeModel: root=vexa-ml arg=x",
       "the older format with a model that the names list"},
      {"<Tree/>", {}, "TreeModel: root=Tree arg=x", "nor does a tree"},
      {"<PMML><AssociationModelLattice/></PMML>",
       {"AssociationModelLattice"},
       "AssociationModel: root=PMML arg=x",
       "the lattice's library"},
      {"<AssocLattice><AssociationModelLattice/></AssocLattice>",
       {"AssociationModelLattice"},
       "AssociationModel: root=AssocLattice arg=x",
       "the lattice's library"},
      {"<SequentialAssociationLattice><TreeModel/></SequentialAssociationLattice>",
       {"TreeModel"},
       "TreeModel: root=SequentialAssociationLattice arg=x",
       "a sequence"},
      {"<PMML><NearestNeighborModel/></PMML>",
       {"NearestNeighborModel"},
       "NearestNeighborModel: root=PMML arg=x",
       "a model of neighbours takes the road of all others"},
      {"<PMML><NearestNeighborModel/><TreeModel/></PMML>",
       {"TreeModel", "NearestNeighborModel"},
       "TreeModel: root=PMML arg=x",
       "and has no precedence"},
  };
  for (const Row& row : rows) {
    EXPECT_EQ(MakeFrom(row.text, row.names), row.story) << row.why;
    EXPECT_EQ(ModelFactory::GetLastLoadError(), "") << row.why;
  }
}

TEST(ModelFactory, DestroysTheTranslatorAndKeepsTheModelsCode) {
  std::istringstream in(kTreeDocument);
  const std::unique_ptr<ScoreModel> model(ModelFactory::MakeModelFromXML(in, {"TreeModel"}, ""));
  EXPECT_EQ(LiveTranslatorsOf("TreeModel"), 0);
  const std::unique_ptr<ScoreResult> result(model->MakeResult());
  EXPECT_TRUE(model->Score(nullptr, result.get()).IsOK());
  ASSERT_NE(result->GetPrediction(), nullptr);
  EXPECT_EQ(result->GetPrediction()->GetDouble(), 42.0);
}

TEST(ModelFactory, LeavesTheCallersNamesAlone) {
  const Names names = {"RegressionModel"};
  EXPECT_EQ(MakeFrom("<PMML><RegressionModel/></PMML>", names),
            "RegressionModel: root=PMML arg=x names=RegressionModel;mark of the plug-in;");
  EXPECT_EQ(names, Names{"RegressionModel"});
}

TEST(ModelFactory, LeavesItsOwnNamesAloneToo) {
  ModelFactory::fModelNames = {"RegressionModel"};
  EXPECT_EQ(MakeFrom("<PMML><RegressionModel/></PMML>", ModelFactory::fModelNames),
            "RegressionModel: root=PMML arg=x names=RegressionModel;mark of the plug-in;");
  EXPECT_EQ(ModelFactory::fModelNames, Names{"RegressionModel"});
}

TEST(ModelFactory, SaysWhichModelHasNoUsableLibrary) {
  struct Row {
    const char* tag;
    const char* named;
    const char* why;
  };
  const Row rows[] = {
      {"NoSuchModel", "NoSuchModel", "absent"},
      {"NotALibrary", "NotALibrary", "a text file"},
      {"Fault_NEEDS_ABSENT", "Fault_NEEDS_ABSENT", "needs a library that is absent"},
      {"Fault_NO_ENTRY", "Fault_NO_ENTRY", "no entry point"},
      {"Fault_NULL_TRANSLATOR", "Fault_NULL_TRANSLATOR", "no translator"},
      {"Fault_OTHER_VERSION", "Fault_OTHER_VERSION", "built for another version"},
      {"Fault_NULL_VERSION", "Fault_NULL_VERSION", "does not know its version"},
      {"x:TreeModel", "x:TreeModel", "a tag that is no file name"},
  };
  for (const Row& row : rows) {
    const std::string text = std::string("<PMML xmlns:x='urn:x'><") + row.tag + "/></PMML>";
    ExpectFault([&] { MakeFrom(text, {row.tag}); }, 5, TextForNoLibrary(row.named), row.why);
    EXPECT_NE(ModelFactory::GetLastLoadError(), "") << row.why;
  }
  MakeFrom("<PMML><VersionedModel/></PMML>", {"VersionedModel"});
  EXPECT_EQ(ModelFactory::GetLastLoadError(), "") << "the right version";
  MakeFrom(kTreeDocument, {"TreeModel"});
  EXPECT_EQ(ModelFactory::GetLastLoadError(), "") << "a load that works leaves nothing behind";
}

TEST(ModelFactory, TellsWhereTheModelWithoutALibraryStands) {
  try {
    MakeFrom("<PMML>\n <NoSuchModel/></PMML>", {"NoSuchModel"});
    FAIL() << "nothing was thrown";
  } catch (const KestrelException& fault) {
    EXPECT_EQ(fault.GetLine(), 2u);
  }
}

TEST(ModelFactory, ThrowsForDocumentsThatItCannotRead) {
  struct Row {
    const char* text;
    int code;
    const char* message;
    const char* why;
  };
  const Row rows[] = {
      {"<PMML><TreeModel></PMML>", 6, "Invalid XML file!!", "a tag is not closed"},
      {"<Other/>", 5, "Unsupported Model found!", "an unknown root"},
      {"<PMML/>", 5, "Unsupported Model found!", "no model"},
  };
  for (const Row& row : rows) {
    ExpectFault([&] { MakeFrom(row.text, {"TreeModel"}); }, row.code, row.message, row.why);
    EXPECT_EQ(ModelFactory::GetLastLoadError(), "") << row.why;
  }
}

TEST(ModelFactory, ForgetsAnEarlierLoadErrorWhenTheNextLoadFailsOtherwise) {
  EXPECT_THROW(MakeFrom("<PMML><NoSuchModel/></PMML>", {"NoSuchModel"}), KestrelException);
  EXPECT_NE(ModelFactory::GetLastLoadError(), "");
  EXPECT_THROW(MakeFrom("<Other/>", {"NoSuchModel"}), KestrelException);
  EXPECT_EQ(ModelFactory::GetLastLoadError(), "");
}

TEST(ModelFactory, PassesOnWhatALibraryThrows) {
  ExpectFault([] { MakeFrom("<PMML><Fault_THROWS_KESTREL/></PMML>", {"Fault_THROWS_KESTREL"}); }, 8,
              "Variable x not in the dictionary!");
  ExpectFault([] { MakeFrom("<PMML><Fault_NAMES_THROW/></PMML>", {"Fault_NAMES_THROW"}); }, 6,
              "no such names");
  try {
    MakeFrom("<PMML><Fault_THROWS_STANDARD/></PMML>", {"Fault_THROWS_STANDARD"});
    ADD_FAILURE() << "nothing was thrown";
  } catch (const std::out_of_range& fault) {
    EXPECT_STREQ(fault.what(), "from the plug-in");
  }
  for (const auto& [tag, expected] :
       {std::pair("Fault_THROWS_INT", 17), std::pair("Fault_ENTRY_THROWS", 18)}) {
    try {
      MakeFrom(std::string("<PMML><") + tag + "/></PMML>", {tag});
      ADD_FAILURE() << "nothing was thrown by " << tag;
    } catch (int thrown) {
      EXPECT_EQ(thrown, expected) << tag;
    }
  }
}

TEST(ModelFactory, HandsOnThatATranslatorBuiltNothing) {
  EXPECT_EQ(MakeFrom("<PMML><Fault_NULL_MODEL/></PMML>", {"Fault_NULL_MODEL"}), "no model");
}

TEST(ModelFactory, ReadsTheStreamFromWhereItIs) {
  std::istringstream in(std::string("skipped") + kTreeDocument);
  in.seekg(7);
  EXPECT_EQ(StoryOf(ModelFactory::MakeModelFromXML(in, {"TreeModel"}, "")), "TreeModel: root=PMML arg=");
}

/// Gives its text once and cannot be set back, as a pipe.
class OneWayBuffer : public std::streambuf {
 public:
  explicit OneWayBuffer(std::string text) : text_(std::move(text)) {
    setg(text_.data(), text_.data(), text_.data() + text_.size());
  }

 private:
  std::string text_;
};

TEST(ModelFactory, OffersBothArgumentsToATranslatorThatTakesTwo) {
  struct Row {
    const char* text;
    const char* tag;
    const char* story;
    const char* why;
  };
  const Row rows[] = {
      {"<PMML><WideModel/></PMML>", "WideModel", "WideModel: text=<PMML><WideModel/></PMML> arg=x second=y",
       "it takes two"},
      {kTreeDocument, "TreeModel", "TreeModel: root=PMML arg=x", "it takes one"},
      {"<PMML><PlainModel/></PMML>", "PlainModel", "PlainModel: root=PMML arg=x", "it lacks the operation"},
  };
  for (const Row& row : rows) {
    std::istringstream in(row.text);
    EXPECT_EQ(StoryOf(ModelFactory::MakeModelFromXML(in, {row.tag}, "x", "y")), row.story) << row.why;
    std::istringstream skipping(std::string("skipped") + row.text);
    skipping.seekg(7);
    EXPECT_EQ(StoryOf(ModelFactory::MakeModelFromXML(skipping, {row.tag}, "x", "y")), row.story) << row.why;
  }
  OneWayBuffer buffer("<PMML><WideModel/></PMML>");
  std::istream pipe(&buffer);
  EXPECT_EQ(StoryOf(ModelFactory::MakeModelFromXML(pipe, {"WideModel"}, "x", "y")),
            "WideModel: root=PMML arg=x")
      << "a stream that cannot be set back";
}

/// Tells where it stands but cannot be set to another place.
class CountingBuffer : public OneWayBuffer {
 public:
  using OneWayBuffer::OneWayBuffer;

 protected:
  pos_type seekoff(off_type offset, std::ios_base::seekdir direction, std::ios_base::openmode) override {
    return offset == 0 && direction == std::ios_base::cur ? pos_type(gptr() - eback()) : pos_type(-1);
  }
};

/// Throws when it is asked where it stands.
class ThrowingBuffer : public OneWayBuffer {
 public:
  using OneWayBuffer::OneWayBuffer;

 protected:
  pos_type seekoff(off_type, std::ios_base::seekdir, std::ios_base::openmode) override { throw 7; }
};

TEST(ModelFactory, LetsNothingOfAThrowingStreamOut) {
  const std::string text = "<PMML><WideModel/></PMML>";
  const std::string from_root = "WideModel: root=PMML arg=x";
  const auto all = std::ios_base::failbit | std::ios_base::badbit | std::ios_base::eofbit;
  CountingBuffer counting(text);
  ThrowingBuffer throwing(text);
  OneWayBuffer one_way(text);
  for (std::streambuf* buffer :
       {static_cast<std::streambuf*>(&counting), static_cast<std::streambuf*>(&throwing),
        static_cast<std::streambuf*>(&one_way)}) {
    std::istream in(buffer);
    in.exceptions(all);
    EXPECT_EQ(StoryOf(ModelFactory::MakeModelFromXML(in, {"WideModel"}, "x", "y")), from_root);
  }
  std::istringstream at_its_end("x");
  at_its_end.get();
  at_its_end.peek();
  at_its_end.exceptions(std::ios_base::failbit);
  ExpectFault([&] { ModelFactory::MakeModelFromXML(at_its_end, {"WideModel"}, "x", "y"); }, 4,
              "\nInvalid XML document or no dtd file avaible in current directory");
  std::istream none(nullptr);
  ExpectFault([&] { ModelFactory::MakeModelFromXML(none, {"WideModel"}, "x", "y"); }, 2,
              "Could not read model file");
}

TEST(ModelFactory, ReadsAFileAndItsNames) {
  const TempFolder folder;
  const std::string model = folder.Write("model.xml", "<PMML><TreeModel/><WideModel/></PMML>");
  const std::string names = folder.Write("names.txt", "NeuralNetwork\nWideModel, TreeModel\n");
  ModelFactory::fModelNames = {"left from before"};
  EXPECT_EQ(StoryOf(ModelFactory::MakeModelFromXML(model, names, "x")), "WideModel: root=PMML arg=x");
  EXPECT_EQ(ModelFactory::fModelNames, (Names{"NeuralNetwork", "WideModel", "TreeModel"}));
  EXPECT_EQ(StoryOf(ModelFactory::MakeModelFromXML(model, names, "x", "y")),
            "WideModel: text=<PMML><TreeModel/><WideModel/></PMML> arg=x second=y");
}

TEST(ModelFactory, TakesUtf8FileNames) {
  const TempFolder folder;
  const std::string model = folder.Write("mod\xC3\xA8le \xE6\xA8\xA1.xml", kTreeDocument);
  const std::string names = folder.Write("n\xC3\xA4men.txt", "TreeModel");
  const int before = MCXML_800::qUTF8mode();
  // Also where all other narrow text is in a code page that has not all of these characters.
  for (const int mode : {0, 1}) {
    MCXML_800::SetUTF8mode(mode);
    EXPECT_EQ(StoryOf(ModelFactory::MakeModelFromXML(model, names, "")), "TreeModel: root=PMML arg=") << mode;
  }
  MCXML_800::SetUTF8mode(before);
}

TEST(ModelFactory, ThrowsForFilesThatItCannotOpen) {
  const TempFolder folder;
  const std::string model = folder.Write("model.xml", kTreeDocument);
  const std::string names = folder.Write("names.txt", "TreeModel");
  const std::string absent = folder.PathOf("absent");
  // Some systems let a folder be opened, but not read.
  const bool opens_folders = std::ifstream(folder.GetPath()).is_open();
  struct Row {
    std::string model;
    std::string names;
    const char* message;
    const char* why;
  };
  const Row rows[] = {
      {model, absent, "Could not open model names file", "no names"},
      {absent, absent, "Could not open model names file", "the names are read first"},
      {absent, names, "Could not open model file", "no model"},
      {"", names, "Could not open model file", "no model's name"},
      {model + std::string("\0x", 2), names, "Could not open model file", "a name that ends early"},
      {folder.GetPath().u8string(), names,
       opens_folders ? "Could not read model file" : "Could not open model file", "a folder"},
  };
  for (const Row& row : rows) {
    ExpectFault([&] { ModelFactory::MakeModelFromXML(row.model, row.names, ""); }, 2, row.message, row.why);
    ExpectFault([&] { ModelFactory::MakeModelFromXML(row.model, row.names, "", ""); }, 2, row.message,
                row.why);
  }
}

TEST(ModelFactory, KeepsItsNamesWhenANamesFileCannotBeOpened) {
  const TempFolder folder;
  ModelFactory::fModelNames = {"TreeModel"};
  EXPECT_THROW(ModelFactory::MakeModelFromXML(folder.PathOf("absent"), folder.PathOf("absent"), ""),
               KestrelException);
  EXPECT_EQ(ModelFactory::fModelNames, Names{"TreeModel"});
}

/// A document that the host has parsed itself.
class HostTree {
 public:
  explicit HostTree(const std::string& text) {
    std::istringstream in(text);
    document_ = ReadDocument(in);
  }
  void* Root() const { return document_->GetRoot(); }
  void* FirstChild() const { return document_->GetRoot()->getFirstElementChild(); }

 private:
  std::unique_ptr<ParsedDocument> document_;
};

TEST(ModelFactory, MakesTheModelOfAnElementOverDictionaries) {
  const HostTree tree("<PMML><WideModel/></PMML>");
  BaseDictionary dictionary;
  BaseDictionary results;
  ScoreDictionary* none = nullptr;
  const Names names = {"WideModel"};
  void* element = tree.FirstChild();
  EXPECT_EQ(StoryOf(ModelFactory::MakeModelFromXML(element, names, &dictionary, "x", &results)),
            "WideModel: model=WideModel dictionary=given results=given arg=x");
  EXPECT_EQ(StoryOf(ModelFactory::MakeModelFromXML(element, names, &dictionary)),
            "WideModel: model=WideModel dictionary=given results=none arg=");
  EXPECT_EQ(StoryOf(ModelFactory::MakeModelFromXML(element, names, none, "x")),
            "WideModel: model=WideModel dictionary=none results=none arg=x");
}

TEST(ModelFactory, MakesTheModelOfTwoElements) {
  const HostTree tree("<PMML><WideModel/></PMML>");
  void* none = nullptr;
  EXPECT_EQ(StoryOf(ModelFactory::MakeModelFromXML(tree.FirstChild(), {"WideModel"}, tree.Root(), "x")),
            "WideModel: model=WideModel other=PMML arg=x");
  EXPECT_EQ(StoryOf(ModelFactory::MakeModelFromXML(tree.FirstChild(), {"WideModel"}, none)),
            "WideModel: model=WideModel other=none arg=");
}

TEST(ModelFactory, TakesOlderTagsOfElements) {
  BaseDictionary dictionary;
  const HostTree tree("<DecisionTree/>");
  const HostTree regression("<Regression/>");
  void* none = nullptr;
  // These stubs offer neither operation, so that no model tells that the library was found.
  EXPECT_EQ(ModelFactory::MakeModelFromXML(tree.Root(), {"TreeModel"}, &dictionary), nullptr);
  EXPECT_EQ(ModelFactory::MakeModelFromXML(regression.Root(), {"RegressionModel"}, none), nullptr);
  EXPECT_EQ(ModelFactory::GetLastLoadError(), "");
}

TEST(ModelFactory, RefusesElementsThatItCannotMakeModelsOf) {
  const HostTree tree("<TreeModel/>");
  const HostTree absent("<NoSuchModel/>");
  BaseDictionary dictionary;
  void* none = nullptr;
  struct Row {
    void* element;
    Names names;
    std::string message;
    const char* why;
  };
  const Row rows[] = {
      {nullptr, {"TreeModel"}, "Empty Node!!", "no element"},
      {tree.Root(), {"RegressionModel"}, "Unsupported Model found!", "not on the list"},
      {absent.Root(), {"NoSuchModel"}, TextForNoLibrary("NoSuchModel"), "no library"},
  };
  for (const Row& row : rows) {
    ExpectFault([&] { ModelFactory::MakeModelFromXML(row.element, row.names, &dictionary); }, 5, row.message,
                row.why);
    ExpectFault([&] { ModelFactory::MakeModelFromXML(row.element, row.names, none); }, 5, row.message,
                row.why);
  }
}

}  // namespace
