#include "kestrel/transform/StepOrder.h"

#include <algorithm>
#include <cstddef>
#include <utility>

namespace MCKestrel_800 {
namespace {

constexpr int kUnvisited = -1;

class Search {
 public:
  explicit Search(const std::vector<std::vector<int>>& needs)
      : needs_(needs),
        index_(needs.size(), kUnvisited),
        low_(needs.size(), 0),
        is_open_(needs.size(), false) {
    order_.steps.reserve(needs.size());
    order_.is_circular.assign(needs.size(), false);
  }

  StepOrder Run() {
    for (std::size_t step = 0; step < needs_.size(); ++step) {
      if (index_[step] == kUnvisited) Visit(static_cast<int>(step));
    }
    return std::move(order_);
  }

 private:
  struct Frame {
    int step;
    std::size_t next;  ///< of its needs
  };

  void Visit(int start) {
    std::vector<Frame> path;
    Open(start, path);
    while (!path.empty()) {
      Frame& frame = path.back();
      const int step = frame.step;
      if (frame.next < needs_[step].size()) {
        const int need = needs_[step][frame.next++];
        if (need == step) order_.is_circular[step] = true;
        if (index_[need] == kUnvisited) {
          Open(need, path);
        } else if (is_open_[need]) {
          low_[step] = std::min(low_[step], index_[need]);
        }
        continue;
      }
      path.pop_back();
      if (!path.empty()) low_[path.back().step] = std::min(low_[path.back().step], low_[step]);
      if (low_[step] == index_[step]) Close(step);
    }
  }

  void Open(int step, std::vector<Frame>& path) {
    index_[step] = low_[step] = count_++;
    is_open_[step] = true;
    open_.push_back(step);
    path.push_back({step, 0});
  }

  // All that was opened since `root` needs one another.
  void Close(int root) {
    const bool is_alone = open_.back() == root;
    int step;
    do {
      step = open_.back();
      open_.pop_back();
      is_open_[step] = false;
      if (!is_alone) order_.is_circular[step] = true;
      order_.steps.push_back(step);
    } while (step != root);
  }

  const std::vector<std::vector<int>>& needs_;
  std::vector<int> index_;
  std::vector<int> low_;
  std::vector<bool> is_open_;
  std::vector<int> open_;
  StepOrder order_;
  int count_ = 0;
};

}  // namespace

StepOrder OrderSteps(const std::vector<std::vector<int>>& needs) {
  return Search(needs).Run();
}

}  // namespace MCKestrel_800
