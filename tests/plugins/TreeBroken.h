// The tree document that tests break, and what comes of loading it.

#ifndef KESTREL_TESTS_PLUGINS_TREEBROKEN_H
#define KESTREL_TESTS_PLUGINS_TREEBROKEN_H

#include <memory>
#include <sstream>
#include <string>

#include "tests/plugins/BrokenModel.h"

namespace kestrel_tests {

inline constexpr char kTree[] = "tests/data/broken/tree.xml";

inline std::string TreeText() {
  return DocumentText(kTree);
}

/// A case that ends at the node "known" with "low".
inline const Cells& TreeCells() {
  static const Cells cells = {
      {"age", "30"}, {"income", "2000"}, {"town", "Rome"}, {"rating", "2"}, {"since", "9000"}};
  return cells;
}

/// Loads a document by the name of its model element and scores with what comes of it; the outcome's text is
/// then the prediction. An exception that is none of ours goes on to the test's caller, which fails it.
inline Outcome LoadTree(const std::string& document, const std::string& why) {
  try {
    std::istringstream in(document);
    const std::unique_ptr<MCKestrel_800::ScoreModel> model(
        MCKestrel_800::ModelFactory::MakeModelFromXML(in, {"TreeModel"}, std::string()));
    return {kLoaded, UseModel(*model, TreeCells(), why)};
  } catch (const MCKestrel_800::KestrelException& fault) {
    return {fault.GetErrorCode(), fault.GetErrorMessage(), fault.GetLine(), fault.GetColumn()};
  }
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_PLUGINS_TREEBROKEN_H
