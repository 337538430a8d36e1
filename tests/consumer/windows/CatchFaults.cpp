// A host that loads a document for each model kind it is given, and tells what the kind's library throws.

#include <exception>
#include <iostream>
#include <memory>
#include <sstream>
#include <string>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/model/ScoreModel.h"

using namespace MCKestrel_800;

namespace {

std::string Load(const std::string& tag) {
  std::istringstream document("<PMML version=\"4.4\"><" + tag + "/></PMML>");
  try {
    const std::unique_ptr<ScoreModel> model(ModelFactory::MakeModelFromXML(document, {tag}, ""));
    return model == nullptr ? "no model" : "a model";
  } catch (const KestrelException& fault) {
    return "KestrelException " + std::to_string(fault.GetErrorCode()) + " " + fault.GetErrorMessage();
  } catch (const std::exception& fault) {
    return std::string("std::exception ") + fault.what();
  } catch (int number) {
    return "int " + std::to_string(number);
  }
}

}  // namespace

int main(int argc, char** argv) {
  for (int i = 1; i < argc; ++i)
    std::cout << argv[i] << ": " << Load(argv[i]) << '\n';
  return argc > 1 ? 0 : 2;
}
