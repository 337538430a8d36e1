#include "tests/plugins/RuleSetReference.h"

#include <algorithm>
#include <cstdio>
#include <initializer_list>

namespace kestrel_tests {
namespace {

using Predicate = ReferencePredicate;

// All numbers here are small multiples of an eighth, which six digits hold.
std::string Text(double number) {
  char text[32];
  std::snprintf(text, sizeof text, "%g", number);
  return text;
}

std::string ValueText(int field, double value) {
  const char* category = kReferenceFields[field].categories[0];
  return category == nullptr ? Text(value) : kReferenceFields[field].categories[static_cast<int>(value)];
}

bool IsOneOf(const std::string& word, std::initializer_list<const char*> words) {
  return std::find(words.begin(), words.end(), word) != words.end();
}

void WriteCounts(const ReferenceCounts& counts, std::string& xml) {
  for (const auto& [score, count] : counts)
    xml += "<ScoreDistribution value='" + score + "' recordCount='" + Text(count) + "'/>";
}

void WriteRules(const std::vector<ReferenceRule>& rules, std::string& xml) {
  for (const ReferenceRule& rule : rules) {
    if (rule.score.empty()) {
      xml += "<CompoundRule>";
      rule.predicate.Write(xml);
      WriteRules(rule.inside, xml);
      xml += "</CompoundRule>";
      continue;
    }
    xml += "<SimpleRule id='" + rule.id + "' score='" + rule.score + "' weight='" + Text(rule.weight) +
           "' confidence='" + Text(rule.confidence) + "'>";
    rule.predicate.Write(xml);
    WriteCounts(rule.counts, xml);
    xml += "</SimpleRule>";
  }
}

}  // namespace

void Predicate::Write(std::string& xml) const {
  const std::string field_name = kReferenceFields[field].name;
  switch (kind) {
    case kTrue:
      xml += "<True/>";
      break;
    case kFalse:
      xml += "<False/>";
      break;
    case kSimple:
      xml += "<SimplePredicate field='" + field_name + "' operator='" + word + "'";
      if (!IsOneOf(word, {"isMissing", "isNotMissing"})) xml += " value='" + ValueText(field, value) + "'";
      xml += "/>";
      break;
    case kSet:
      xml += "<SimpleSetPredicate field='" + field_name + "' booleanOperator='" + word +
             "'><Array type='string'>";
      for (int i = 0; i < 3; ++i) {
        if (members[i]) xml += ValueText(field, i) + " ";
      }
      xml += "</Array></SimpleSetPredicate>";
      break;
    case kCompound:
      xml += "<CompoundPredicate booleanOperator='" + word + "'>";
      for (const Predicate& child : children)
        child.Write(xml);
      xml += "</CompoundPredicate>";
  }
}

Predicate::Answer Predicate::Decide(const ReferenceCase& cells) const {
  switch (kind) {
    case kTrue:
      return kYes;
    case kFalse:
      return kNo;
    case kCompound:
      return DecideCompound(cells);
    case kSet: {
      const ReferenceCell& cell = cells[static_cast<size_t>(field)];
      if (cell.is_missing) return kUnknown;
      return members[static_cast<int>(cell.value)] == (word == "isIn") ? kYes : kNo;
    }
    default:
      return DecideSimple(cells[static_cast<size_t>(field)]);
  }
}

Predicate::Answer Predicate::DecideSimple(const ReferenceCell& cell) const {
  if (word == "isMissing") return cell.is_missing ? kYes : kNo;
  if (cell.is_missing) return kUnknown;
  if (word == "isNotMissing") return kYes;
  const bool is_equal = cell.value == value;
  const bool holds = (is_equal && IsOneOf(word, {"equal", "lessOrEqual", "greaterOrEqual"})) ||
                     (!is_equal && word == "notEqual") ||
                     (cell.value < value && IsOneOf(word, {"lessThan", "lessOrEqual"})) ||
                     (cell.value > value && IsOneOf(word, {"greaterThan", "greaterOrEqual"}));
  return holds ? kYes : kNo;
}

Predicate::Answer Predicate::DecideCompound(const ReferenceCase& cells) const {
  // Constants that change nothing are left out, and what is left alone answers for itself.
  std::vector<Answer> answers;
  for (const Predicate& child : children) {
    if ((word == "and" && child.kind == kTrue) || (word == "or" && child.kind == kFalse)) continue;
    answers.push_back(child.Decide(cells));
  }
  if (answers.empty()) return word == "and" ? kYes : kNo;
  if (answers.size() == 1) return answers[0];
  const auto has = [&answers](Answer wanted) {
    return std::find(answers.begin(), answers.end(), wanted) != answers.end();
  };
  if (word == "or") return has(kYes) ? kYes : has(kUnknown) ? kUnknown : kNo;
  if (word == "and") return has(kNo) ? kNo : has(kUnknown) ? kUnknown : kYes;
  if (word == "xor") {
    if (has(kUnknown)) return kUnknown;
    return std::count(answers.begin(), answers.end(), kYes) % 2 == 1 ? kYes : kNo;
  }
  for (size_t i = 0; i < answers.size(); ++i) {
    if (answers[i] != kUnknown) return answers[i] == kYes && i > 0 ? kSurrogateYes : answers[i];
  }
  return kUnknown;
}

bool ReferenceAnswer::operator==(const ReferenceAnswer& other) const {
  return prediction == other.prediction && probability == other.probability && deciding == other.deciding &&
         path == other.path && categories == other.categories;
}

std::string ToText(const ReferenceAnswer& answer) {
  std::string text = answer.prediction + " " + Text(answer.probability) + " " + answer.deciding + ";";
  for (const std::string& id : answer.path)
    text += " " + id;
  text += ";";
  for (const auto& [category, probability] : answer.categories)
    text += " " + category + "=" + Text(probability);
  return text;
}

ReferenceRuleSet::ReferenceRuleSet(unsigned seed) : random_(seed) {
  const char* const criteria[] = {"firstHit", "weightedMax", "weightedSum"};
  const char* const targets[] = {"k", "k", "t", "y"};
  criterion_ = criteria[Draw(3)];
  target_ = targets[Draw(4)];
  rules_ = MakeRules(0);
  if (Chance(60)) {
    default_score_ = DrawScore();
    if (Chance(70)) default_confidence_ = Draw(9) / 8.0;
    if (Chance(50)) counts_ = MakeCounts();
  }
  if (target_ == "k") categories_ = {"u", "v", "w"};
  NoteRules(rules_, false);
  if (!default_score_.empty()) Note(default_score_);
  NoteRules(rules_, true);
  for (const auto& [score, count] : counts_)
    Note(score);
}

std::string ReferenceRuleSet::DrawScore() {
  const char* const numbers[] = {"-1.5", "2", "30"};
  const char* const texts[] = {"w", "v", "u"};
  return target_ == "y" ? numbers[Draw(3)] : texts[Draw(3)];
}

ReferenceCounts ReferenceRuleSet::MakeCounts() {
  ReferenceCounts counts;
  if (target_ == "y") return counts;
  for (const char* score : {"v", "u", "w"}) {
    if (Chance(60)) counts.emplace_back(score, Draw(4));
  }
  return counts;
}

std::vector<ReferenceRule> ReferenceRuleSet::MakeRules(int depth) {
  std::vector<ReferenceRule> rules(Draw(depth == 0 ? 7 : 4));
  for (ReferenceRule& rule : rules) {
    rule.predicate = MakePredicate(0);
    if (depth < 4 && Chance(35)) {
      rule.inside = MakeRules(depth + 1);
      continue;
    }
    rule.score = DrawScore();
    if (Chance(50)) rule.id = "r" + std::to_string(Draw(1000));
    rule.weight = Chance(5) ? -0.5 : Draw(9) / 4.0;
    rule.confidence = Draw(9) / 8.0;
    if (Chance(40)) rule.counts = MakeCounts();
  }
  return rules;
}

ReferencePredicate ReferenceRuleSet::MakePredicate(int depth) {
  Predicate predicate;
  const unsigned kind = Draw(100);
  if (kind < 12) return predicate;
  if (kind < 18) {
    predicate.kind = Predicate::kFalse;
    return predicate;
  }
  return kind < 50 && depth < 3 ? MakeCompound(depth) : MakeTest();
}

ReferencePredicate ReferenceRuleSet::MakeCompound(int depth) {
  Predicate predicate;
  predicate.kind = Predicate::kCompound;
  const char* const words[] = {"or", "and", "xor", "surrogate"};
  predicate.word = words[Draw(4)];
  const unsigned count = 1 + Draw(4);
  for (unsigned i = 0; i < count; ++i)
    predicate.children.push_back(MakePredicate(depth + 1));
  return predicate;
}

ReferencePredicate ReferenceRuleSet::MakeTest() {
  Predicate predicate;
  predicate.field = static_cast<int>(Draw(kReferenceFieldCount));
  const bool is_number = predicate.field < 2;
  const bool is_ordinal = predicate.field >= 4;
  if (!is_number && Chance(40)) {
    predicate.kind = Predicate::kSet;
    predicate.word = Chance(50) ? "isIn" : "isNotIn";
    // One member or two: a set and its complement are never empty.
    const unsigned first = Draw(3);
    predicate.members[first] = true;
    predicate.members[(first + Draw(2)) % 3] = true;
    return predicate;
  }
  predicate.kind = Predicate::kSimple;
  const char* const words[] = {"equal",       "notEqual",       "isMissing", "isNotMissing",
                               "lessOrEqual", "greaterOrEqual", "lessThan",  "greaterThan"};
  predicate.word = words[Draw(is_number || is_ordinal ? 8 : 4)];
  predicate.value = is_number ? Draw(9) / 2.0 - 2.0 : Draw(3);
  // What no category can satisfy is refused.
  if (is_ordinal && predicate.word == "lessThan" && predicate.value == 0.0) predicate.value = 1.0;
  if (is_ordinal && predicate.word == "greaterThan" && predicate.value == 2.0) predicate.value = 1.0;
  return predicate;
}

void ReferenceRuleSet::Note(const std::string& score) {
  if (std::find(categories_.begin(), categories_.end(), score) == categories_.end())
    categories_.push_back(score);
}

void ReferenceRuleSet::NoteRules(const std::vector<ReferenceRule>& rules, bool distributions) {
  for (const ReferenceRule& rule : rules) {
    if (!distributions && !rule.score.empty()) Note(rule.score);
    if (distributions) {
      for (const auto& [score, count] : rule.counts)
        Note(score);
    }
    NoteRules(rule.inside, distributions);
  }
}

std::string ReferenceRuleSet::GetDocument() const {
  std::string xml = "<PMML version='4.4'><DataDictionary numberOfFields='9'>";
  for (const ReferenceField& field : kReferenceFields) {
    xml += std::string("<DataField name='") + field.name + "' optype='" + field.optype + "' dataType='" +
           field.type + "'>";
    for (const char* category : field.categories) {
      if (category != nullptr) xml += std::string("<Value value='") + category + "'/>";
    }
    xml += "</DataField>";
  }
  xml +=
      "<DataField name='k' optype='categorical' dataType='string'><Value value='u'/><Value value='v'/><Value "
      "value='w'/></DataField><DataField name='t' optype='categorical' dataType='string'/><DataField "
      "name='y' "
      "optype='continuous' dataType='double'/></DataDictionary><RuleSetModel functionName='";
  xml += target_ == "y" ? "regression" : "classification";
  xml += "'><MiningSchema>";
  for (const ReferenceField& field : kReferenceFields)
    xml += std::string("<MiningField name='") + field.name + "'/>";
  xml += "<MiningField name='" + target_ + "' usageType='target'/></MiningSchema><RuleSet defaultScore='" +
         default_score_ + "' defaultConfidence='" +
         (default_confidence_ < 0.0 ? std::string() : Text(default_confidence_)) +
         "'><RuleSelectionMethod criterion='" + criterion_ + "'/>";
  WriteCounts(counts_, xml);
  WriteRules(rules_, xml);
  return xml + "</RuleSet></RuleSetModel></PMML>";
}

ReferenceCase ReferenceRuleSet::MakeCase() {
  ReferenceCase cells(kReferenceFieldCount);
  for (int field = 0; field < kReferenceFieldCount; ++field) {
    ReferenceCell& cell = cells[static_cast<size_t>(field)];
    cell.is_missing = Chance(20);
    cell.value = field < 2 ? Draw(9) / 2.0 - 2.0 : Draw(3);
  }
  return cells;
}

void ReferenceRuleSet::FindFiring(const std::vector<ReferenceRule>& rules, bool is_open,
                                  const ReferenceCase& cells, int& number,
                                  std::vector<Firing>& firing) const {
  for (const ReferenceRule& rule : rules) {
    const Predicate::Answer answer = rule.predicate.Decide(cells);
    const bool fires = is_open && (answer == Predicate::kYes || answer == Predicate::kSurrogateYes);
    if (rule.score.empty()) {
      FindFiring(rule.inside, fires, cells, number, firing);
      continue;
    }
    ++number;
    if (fires) firing.push_back({&rule, rule.id.empty() ? "#" + std::to_string(number) : rule.id});
  }
}

ReferenceAnswer ReferenceRuleSet::Answer(const ReferenceCase& cells) const {
  ReferenceAnswer answer;
  std::vector<Firing> firing;
  int number = 0;
  FindFiring(rules_, true, cells, number, firing);
  for (const Firing& fired : firing)
    answer.path.push_back(fired.name);
  if (!firing.empty()) {
    criterion_ == "weightedSum" ? ChooseBySum(firing, answer) : Choose(firing, answer);
  } else if (!default_score_.empty()) {
    answer.prediction = default_score_;
    answer.probability = std::max(default_confidence_, 0.0);
    Distribute(counts_, answer);
    if (answer.categories.empty() && default_confidence_ >= 0.0)
      answer.categories = {{default_score_, default_confidence_}};
  }
  if (target_ == "y") answer.categories.clear();
  return answer;
}

void ReferenceRuleSet::Choose(const std::vector<Firing>& firing, ReferenceAnswer& answer) const {
  const Firing* best = &firing[0];
  for (const Firing& fired : firing) {
    if (criterion_ == "weightedMax" && fired.rule->weight > best->rule->weight) best = &fired;
  }
  answer.prediction = best->rule->score;
  answer.probability = best->rule->confidence;
  answer.deciding = best->name;
  Distribute(best->rule->counts, answer);
  if (answer.categories.empty()) answer.categories = {{answer.prediction, answer.probability}};
}

void ReferenceRuleSet::ChooseBySum(const std::vector<Firing>& firing, ReferenceAnswer& answer) const {
  double best_sum = 0.0;
  double total = 0.0;
  bool is_negative = false;
  for (const std::string& category : categories_) {
    double weight = 0.0;
    double confidence = 0.0;
    const Firing* heaviest = nullptr;
    for (const Firing& fired : firing) {
      if (fired.rule->score != category) continue;
      weight += fired.rule->weight;
      confidence += fired.rule->confidence;
      if (heaviest == nullptr || fired.rule->weight > heaviest->rule->weight) heaviest = &fired;
    }
    total += weight;
    is_negative |= weight < 0.0;
    answer.categories.emplace_back(category, weight);
    if (heaviest == nullptr || (!answer.prediction.empty() && weight <= best_sum)) continue;
    best_sum = weight;
    answer.prediction = category;
    answer.probability = confidence / static_cast<double>(firing.size());
    answer.deciding = heaviest->name;
  }
  if (is_negative || total == 0.0) {
    answer.categories = {{answer.prediction, answer.probability}};
    return;
  }
  for (auto& [category, share] : answer.categories)
    share /= total;
}

void ReferenceRuleSet::Distribute(const ReferenceCounts& counts, ReferenceAnswer& answer) const {
  double total = 0.0;
  for (const auto& [score, count] : counts)
    total += count;
  if (total == 0.0) return;
  for (const std::string& category : categories_) {
    double share = 0.0;
    for (const auto& [score, count] : counts) {
      if (score == category) share = count / total;
    }
    answer.categories.emplace_back(category, share);
  }
}

}  // namespace kestrel_tests
