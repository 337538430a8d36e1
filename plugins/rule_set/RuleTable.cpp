#include "plugins/rule_set/RuleTable.h"

namespace MCKestrel_800 {

int RuleTable::Add(const Condition& condition, const Rule& rule, std::string_view id) {
  conditions_.push_back(condition);
  rules_.push_back(rule);
  conditions_.back().next = GetCount();
  if (rule.score != kNone) {
    ++simple_count_;
    if (id.empty()) {
      ids_ += "#" + std::to_string(simple_count_);
    } else {
      ids_ += id;
    }
  }
  id_ends_.push_back(ids_.size());
  return GetCount() - 1;
}

void RuleTable::Seal() {
  parts_.Seal();
  conditions_.shrink_to_fit();
  rules_.shrink_to_fit();
  ids_.shrink_to_fit();
  id_ends_.shrink_to_fit();
}

std::string_view RuleTable::GetId(int rule) const {
  const std::size_t begin = rule == 0 ? 0 : id_ends_[rule - 1];
  return std::string_view(ids_).substr(begin, id_ends_[rule] - begin);
}

}  // namespace MCKestrel_800
