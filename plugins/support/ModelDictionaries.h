// The fields of a document on their way into a model.

#ifndef KESTREL_PLUGINS_SUPPORT_MODELDICTIONARIES_H
#define KESTREL_PLUGINS_SUPPORT_MODELDICTIONARIES_H

#include <memory>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/model/ScoreModel.h"
#include "kestrel/transform/TransformationDictionary.h"

namespace MCKestrel_800 {

/// The dictionaries that become a model's own. What is read from the document points at their variables.
struct ModelDictionaries {
  std::unique_ptr<ScoreDictionary> data;
  /// The derived fields, which refer to variables of `data`; null when there are none.
  std::unique_ptr<TransformationDictionary> derived;
  /// The output fields; null when there are none.
  std::unique_ptr<ScoreDictionary> results;

  /// Hands all over.
  void GiveTo(ScoreModel& model) {
    model.SetScoreDictionary(data.release());
    model.SetTransformationScoreDictionary(derived.release());
    model.SetResultScoreDictionary(results.release());
  }
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_MODELDICTIONARIES_H
