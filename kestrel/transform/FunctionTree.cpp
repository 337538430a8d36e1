#include "kestrel/transform/FunctionTree.h"

namespace MCKestrel_800 {

FunctionTree::~FunctionTree() = default;

}  // namespace MCKestrel_800
