#ifndef CENTROID_CENTROIDTRANSLATOR_H
#define CENTROID_CENTROIDTRANSLATOR_H

#include "plugins/support/ModelTranslator.h"

namespace centroid {

/// Reads CentroidModel elements. Faults of the document are thrown as KestrelException with their place.
class CentroidTranslator : public MCKestrel_800::ModelTranslator {
 public:
  CentroidTranslator() : ModelTranslator("CentroidModel") {}

 protected:
  std::unique_ptr<MCKestrel_800::ScoreModel> BuildModel(
      xercesc::DOMElement* element, MCKestrel_800::ModelDictionaries dictionaries) override;
};

}  // namespace centroid

#endif  // CENTROID_CENTROIDTRANSLATOR_H
