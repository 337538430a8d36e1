// Tests of finding the model of a document.

#include "kestrel/model/ModelFinder.h"

#include <gtest/gtest.h>

#include <sstream>
#include <string>
#include <vector>
#include <xercesc/dom/DOMElement.hpp>

#include "kestrel/translate/DocumentReader.h"
#include "kestrel/translate/XmlText.h"
#include "tests/support/ExpectFault.h"

namespace {

using namespace MCKestrel_800;
using kestrel_tests::ExpectFault;

using Names = std::vector<std::string>;

std::unique_ptr<ParsedDocument> Parse(const std::string& text) {
  std::istringstream in(text);
  return ReadDocument(in);
}

TEST(ModelFinder, DispatchesOnTheRoot) {
  const Names names = {"NeuralNetwork",           "TreeModel",        "RegressionModel",
                       "AssociationModelLattice", "AssociationModel", "Only"};
  struct Row {
    const char* text;
    const char* tag;
    const char* element;
    const char* why;
  };
  const Row rows[] = {
      {"<PMML><TreeModel/></PMML>", "TreeModel", "TreeModel", "the one model"},
      {"<PMML><RegressionModel/><TreeModel/></PMML>", "TreeModel", "TreeModel",
       "the list's order, not the document's"},
      {"<PMML><TreeModel/><RegressionModel/></PMML>", "TreeModel", "TreeModel",
       "the same the other way round"},
      {"<PMML><MiningModel><Segment><RegressionModel/></Segment></MiningModel></PMML>", "RegressionModel",
       "RegressionModel", "anywhere in the document"},
      {"<PMML><MiningModel><NeuralNetwork/></MiningModel><TreeModel/></PMML>", "NeuralNetwork",
       "NeuralNetwork", "a nested one that stands nearer to the front of the list"},
      {"<PMML><AssociationModelLattice/></PMML>", "AssociationModel", "AssociationModelLattice",
       "the lattice is its model's"},
      {"<PMML><AssociationModel/></PMML>", "AssociationModel", "AssociationModel",
       "the plain association model"},
      {"<vexa-ml><regression-model/></vexa-ml>", "GeneralRegressionModel", "regression-model",
       "the older format"},
      {"<vexa-ml><TreeModel/><a><regression-model/></a></vexa-ml>", "GeneralRegressionModel",
       "regression-model", "the sign goes before the names, however deep"},
      {"<vexa-ml><TreeModel/></vexa-ml>", "TreeModel", "TreeModel",
       "the older format without the sign is searched"},
      {"<vexa-ml><AssociationModelLattice/></vexa-ml>", "AssociationModel", "AssociationModelLattice",
       "and the lattice found in it is its model's"},
      {"<PMML><regression-model/><TreeModel/></PMML>", "TreeModel", "TreeModel",
       "elsewhere the sign says nothing"},
      {"<Tree/>", "TreeModel", "Tree", "a tree alone"},
      {"<Tree><NeuralNetwork/></Tree>", "TreeModel", "Tree", "a tree is not searched"},
      {"<AssocLattice><Only/></AssocLattice>", "Only", "Only", "searched"},
      {"<AssocLattice><AssociationModelLattice/></AssocLattice>", "AssociationModel",
       "AssociationModelLattice", "the lattice is its model's"},
      {"<SequentialAssociationLattice><Only/></SequentialAssociationLattice>", "Only", "Only", "searched"},
      {"<SequentialAssociationLattice><Only/><AssociationModelLattice/></SequentialAssociationLattice>",
       "AssociationModel", "AssociationModelLattice", "searched in the list's order"},
  };
  for (const Row& row : rows) {
    const auto document = Parse(row.text);
    const FoundModel found = FindModel(document->GetRoot(), names);
    EXPECT_EQ(found.tag, row.tag) << row.why;
    EXPECT_EQ(Narrow(found.element->getTagName()), row.element) << row.why;
  }
}

TEST(ModelFinder, NeedsNoNamesWhereTheRootSettlesTheModel) {
  for (const Names& names : {Names{}, Names{"NeuralNetwork"}}) {
    EXPECT_EQ(FindModel(Parse("<Tree/>")->GetRoot(), names).tag, "TreeModel");
    EXPECT_EQ(FindModel(Parse("<vexa-ml><a><regression-model/></a></vexa-ml>")->GetRoot(), names).tag,
              "GeneralRegressionModel");
  }
}

TEST(ModelFinder, RefusesWhatItDoesNotKnow) {
  struct Row {
    const char* text;
    Names names;
    const char* why;
  };
  const Row rows[] = {
      {"<Other><TreeModel/></Other>", {"TreeModel"}, "an unknown root is not searched"},
      {"<TreeModel/>", {"TreeModel"}, "nor is a model's own element as the root"},
      {"<pmml><TreeModel/></pmml>", {"TreeModel"}, "case counts"},
      {"<tree/>", {"TreeModel"}, "case counts"},
      {"<PMML><TreeModel/></PMML>", {}, "no names"},
      {"<PMML><TreeModel/></PMML>", {"RegressionModel"}, "a model that is not on the list"},
      {"<PMML><TreeModel/></PMML>", {"treemodel"}, "case counts in names"},
      {"<PMML><TreeModel/></PMML>", {"*"}, "a name is no pattern"},
      {"<PMML><TreeModel/></PMML>", {""}, "an empty name is no tag"},
      {"<PMML><TreeModel/></PMML>", {"Tree", "Model", "TreeModel ", " TreeModel"}, "exact tags alone"},
      {"<PMML><!-- <TreeModel/> --></PMML>", {"TreeModel"}, "a comment holds no elements"},
      {"<PMML><a TreeModel='1'>TreeModel</a></PMML>", {"TreeModel"}, "neither attributes nor text count"},
      {"<PMML xmlns:p='urn:p'><p:TreeModel/></PMML>", {"TreeModel"}, "a prefix is part of the tag"},
      {"<PMML/>", {"TreeModel"}, "an empty document"},
      {"<vexa-ml><regressionmodel/></vexa-ml>", {"TreeModel"}, "the older format without a model"},
      {"<AssocLattice/>", {"TreeModel"}, "a lattice without a model"},
      {"<SequentialAssociationLattice/>", {"TreeModel"}, "a sequence without a model"},
  };
  for (const Row& row : rows) {
    const auto document = Parse(row.text);
    ExpectFault([&] { FindModel(document->GetRoot(), row.names); }, 5, "Unsupported Model found!", row.why);
  }
}

TEST(ModelFinder, TellsWhereTheUnsupportedDocumentBegins) {
  const auto document = Parse("<?xml version='1.0'?>\n\n<Other>\n</Other>");
  try {
    FindModel(document->GetRoot(), {"TreeModel"});
    FAIL() << "nothing was thrown";
  } catch (const KestrelException& fault) {
    EXPECT_EQ(fault.GetLine(), 3u);
    EXPECT_GT(fault.GetColumn(), 0u);
  }
}

TEST(ModelFinder, TakesTheFirstElementOfTheWinningName) {
  const auto document = Parse("<PMML><a><TreeModel id='1'/></a><TreeModel id='2'/></PMML>");
  const FoundModel found = FindModel(document->GetRoot(), {"Absent", "TreeModel"});
  EXPECT_EQ(AttributeText(found.element, u"id"), "1");
}

TEST(ModelFinder, FindsTheRootItselfWhenItsTagIsOnTheList) {
  const auto document = Parse("<PMML><TreeModel/></PMML>");
  EXPECT_EQ(FindModel(document->GetRoot(), {"PMML", "TreeModel"}).tag, "PMML");
}

TEST(ModelFinder, LetsOddNamesPassBeforeAndBehindTheRightOne) {
  const auto document = Parse("<PMML><a/><TreeModel/><b/></PMML>");
  EXPECT_EQ(FindModel(document->GetRoot(), {"", "*", "../TreeModel", "TreeModel", "TreeModel", "a"}).tag,
            "TreeModel");
}

// A walk for each name would be a thousand million steps here.
TEST(ModelFinder, TakesManyNamesAndManyElementsInOneWalk) {
  std::string text = "<PMML>";
  for (int i = 0; i < 20000; ++i)
    text += "<Node><Value/></Node>";
  text += "<TreeModel/></PMML>";
  Names names;
  for (int i = 0; i < 50000; ++i)
    names.push_back("Model" + std::to_string(i));
  names.push_back("TreeModel");
  const auto document = Parse(text);
  // A walk for each name would take minutes.
  EXPECT_EQ(FindModel(document->GetRoot(), names).tag, "TreeModel");
}

TEST(ModelFinder, WalksAsDeepAsADocumentMayBe) {
  std::string text = "<PMML>";
  for (int i = 0; i < 500; ++i)
    text += "<Extension>";
  text += "<TreeModel/>";
  for (int i = 0; i < 500; ++i)
    text += "</Extension>";
  text += "<RegressionModel/></PMML>";
  const auto document = Parse(text);
  EXPECT_EQ(FindModel(document->GetRoot(), {"None", "TreeModel"}).tag, "TreeModel");
  EXPECT_EQ(FindModel(document->GetRoot(), {"None", "RegressionModel"}).tag, "RegressionModel");
}

TEST(ModelFinder, ReadsTheTagOfASingleElement) {
  struct Row {
    const char* text;
    const char* tag;
    const char* why;
  };
  const Row rows[] = {
      {"<TreeModel/>", "TreeModel", "as it stands"},
      {"<DecisionTree/>", "TreeModel", "an older tag"},
      {"<Regression/>", "RegressionModel", "an older tag"},
      {"<RegressionModel/>", "RegressionModel", "as it stands"},
      {"<AssociationModelLattice/>", "AssociationModel", "the lattice is its model's"},
  };
  const Names names = {"RegressionModel", "AssociationModelLattice", "TreeModel"};
  for (const Row& row : rows) {
    const auto document = Parse(row.text);
    EXPECT_EQ(ModelOfElement(document->GetRoot(), names).tag, row.tag) << row.why;
  }
}

TEST(ModelFinder, RefusesASingleElementThatIsNotOnTheList) {
  struct Row {
    const char* text;
    Names names;
    const char* why;
  };
  const Row rows[] = {
      {"<TreeModel/>", {"RegressionModel"}, "not on the list"},
      {"<TreeModel/>", {}, "no list"},
      {"<DecisionTree/>", {"DecisionTree"}, "what the older tag stands for must be on the list"},
      {"<PMML><TreeModel/></PMML>", {"TreeModel"}, "the element itself is meant, not what is in it"},
  };
  for (const Row& row : rows) {
    const auto document = Parse(row.text);
    ExpectFault([&] { ModelOfElement(document->GetRoot(), row.names); }, 5, "Unsupported Model found!",
                row.why);
  }
  ExpectFault([&] { ModelOfElement(nullptr, {"TreeModel"}); }, 5, "Empty Node!!");
}

}  // namespace
