// What the sets of value labels and of value probabilities have in common: owned elements, found by their
// value.

#ifndef KESTREL_DICTIONARY_INDEXEDELEMENTS_H
#define KESTREL_DICTIONARY_INDEXEDELEMENTS_H

#include <cstddef>
#include <memory>
#include <typeinfo>
#include <vector>

#include "kestrel/dictionary/ValueIndex.h"

namespace MCKestrel_800 {

/// Elements of an interface with `GetValue`, `operator==` and `Clone`, owned and in order of arrival, with
/// look-ups that answer as a walk would.
///
/// `Element` is the implementation whose elements are filed by their value, a FiledValue `value_`, which
/// raises our flag when another one is put in. Other implementations are asked each time. While the flag
/// is up, look-ups walk; the next `Add` or `Remove` files everything anew. Nothing const changes anything, so
/// readers need no lock.
template <class Interface, class Element>
class IndexedElements {
 public:
  static constexpr std::size_t kNone = ValueIndex::kNone;

  IndexedElements() = default;
  // Through the default constructor, so that the destructor runs when a clone cannot be made.
  IndexedElements(const IndexedElements& other) : IndexedElements() { AppendClones(other); }
  IndexedElements& operator=(const IndexedElements& other) {
    if (this == &other) return *this;
    IndexedElements copy(other);
    Clear();
    elements_.swap(copy.elements_);
    FileAll();
    return *this;
  }
  ~IndexedElements() { Clear(); }

  const std::vector<Interface*>& All() const { return elements_; }

  /// Takes ownership; null is refused.
  bool Add(Interface* element) {
    if (element == nullptr) return false;
    elements_.push_back(element);
    const bool outgrown = index_.Size() == 0 && elements_.size() > ValueIndex::kSmall;
    if (changed_ || outgrown) {
      FileAll();
    } else {
      Watch(element);
      if (index_.Size() != 0) FileNext(*element);
    }
    return true;
  }

  /// Deletes the first element equal to the argument.
  bool Remove(const Interface* element) {
    if (element == nullptr) return false;
    const std::size_t position = FirstEqual(*element);
    if (position == kNone) return false;
    const std::unique_ptr<Interface> removed(elements_[position]);
    elements_.erase(elements_.begin() + static_cast<std::ptrdiff_t>(position));
    if (changed_) {
      FileAll();
    } else if (index_.Size() != 0) {
      index_.Erase(position);
      if (IsOtherThanText(*removed)) --othersThanText_;
    }
    return true;
  }

  /// The first position whose element's value says that it equals `value`; kNone for null.
  std::size_t FirstWithValue(const ScoreValue* value) const {
    if (value == nullptr) return kNone;
    return First(value, [&](std::size_t position) {
      const ScoreValue* own = elements_[position]->GetValue();
      return own != nullptr && *own == *value;
    });
  }

  /// True when `value` says of some element's value that it equals it. Values of foreign classes apart, the
  /// same as asking the other way round.
  bool AnyEqualTo(const ScoreValue* value) const {
    if (value == nullptr) return false;
    const auto matches = [&](std::size_t position) {
      const ScoreValue* own = elements_[position]->GetValue();
      return own != nullptr && *value == *own;
    };
    return First(value, matches) != kNone;
  }

  /// True when some element's value gives `Equal(value, exact, emptyStringOK)`.
  bool AnyEqual(const ScoreValue* value, bool exact, bool emptyStringOK) const {
    if (value == nullptr) return false;
    const auto matches = [&](std::size_t position) {
      const ScoreValue* own = elements_[position]->GetValue();
      return own != nullptr && own->Equal(value, exact, emptyStringOK);
    };
    // Only texts answer `Equal` as they answer the operator; a number is "equal" to everything.
    if (othersThanText_ != 0) return Walk(matches) != kNone;
    return First(value, matches) != kNone;
  }

 private:
  template <class Matches>
  std::size_t Walk(const Matches& matches) const {
    for (std::size_t position = 0; position < elements_.size(); ++position) {
      if (matches(position)) return position;
    }
    return kNone;
  }

  template <class Matches>
  std::size_t First(const ScoreValue* value, const Matches& matches) const {
    if (index_.Size() == 0 || changed_) return Walk(matches);
    const ValueKey key = MakeValueKey(value);
    if (key.kind == ValueKey::kForeign) return Walk(matches);
    return index_.FirstOf(key, matches);
  }

  std::size_t FirstEqual(const Interface& element) const {
    return First(element.GetValue(), [&](std::size_t position) { return *elements_[position] == element; });
  }

  static bool IsOwnKind(const Interface& element) { return typeid(element) == typeid(Element); }

  static bool IsOtherThanText(const Interface& element) {
    if (!IsOwnKind(element)) return false;
    const ValueKey::Kind kind = MakeValueKey(element.GetValue()).kind;
    return kind != ValueKey::kText && kind != ValueKey::kForeign;
  }

  void Watch(Interface* element) {
    if (IsOwnKind(*element)) static_cast<Element*>(element)->value_.Watch(&changed_);
  }

  void FileNext(const Interface& element) {
    const ValueKey key = IsOwnKind(element) ? MakeValueKey(element.GetValue()) : ValueKey();
    if (key.kind == ValueKey::kForeign) {
      index_.AppendForeign();
      return;
    }
    if (key.kind != ValueKey::kText) ++othersThanText_;
    if (key.IsFiled()) {
      index_.Append(key.own);
    } else {
      index_.AppendUnfiled();
    }
  }

  void FileAll() {
    index_.Clear();
    othersThanText_ = 0;
    changed_ = false;
    for (Interface* element : elements_)
      Watch(element);
    if (elements_.size() <= ValueIndex::kSmall) return;
    for (const Interface* element : elements_)
      FileNext(*element);
  }

  void AppendClones(const IndexedElements& other) {
    elements_.reserve(other.elements_.size());
    for (const Interface* element : other.elements_)
      elements_.push_back(element->Clone());
    FileAll();
  }

  void Clear() {
    for (Interface* element : elements_)
      delete element;
    elements_.clear();
    index_.Clear();
    othersThanText_ = 0;
    changed_ = false;
  }

  std::vector<Interface*> elements_;
  ValueIndex index_;
  std::size_t othersThanText_ = 0;
  bool changed_ = false;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_INDEXEDELEMENTS_H
