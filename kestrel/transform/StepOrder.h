// Puts things that need one another in an order in which each comes behind what it needs.

#ifndef KESTREL_TRANSFORM_STEPORDER_H
#define KESTREL_TRANSFORM_STEPORDER_H

#include <vector>

namespace MCKestrel_800 {

struct StepOrder {
  std::vector<int> steps;         ///< all of them; what is circular stands together, in any order
  std::vector<bool> is_circular;  ///< by step: whether it needs itself, by whatever way
};

/// needs  by step: the steps that it needs.
/// R. Tarjan, Depth-first search and linear graph algorithms, SIAM J. Comput. 1 (1972), with the stack held
/// on the heap. Time and memory in proportion to the steps and needs.
StepOrder OrderSteps(const std::vector<std::vector<int>>& needs);

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_STEPORDER_H
