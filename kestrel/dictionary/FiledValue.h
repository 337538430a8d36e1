// The value that a label or a probability stands for.

#ifndef KESTREL_DICTIONARY_FILEDVALUE_H
#define KESTREL_DICTIONARY_FILEDVALUE_H

#include <memory>

#include "kestrel/foundation/ScoreValue.h"

namespace MCKestrel_800 {

/// A value, or none, that its holder owns and that is copied with it. The set that owns the holder files it
/// by this value, and is told when another value is put in.
class FiledValue {
 public:
  /// Takes ownership; null is none.
  explicit FiledValue(ScoreValue* value) : value_(value) {}
  /// A copy belongs to no set yet.
  FiledValue(const FiledValue& other) : value_(other.NewCopy()) {}
  /// The value changes, the set stays.
  FiledValue& operator=(const FiledValue& other) {
    if (this != &other) Put(other.NewCopy());
    return *this;
  }
  ~FiledValue() = default;

  const ScoreValue* Get() const { return value_.get(); }

  /// Takes ownership of `value`, which may be the one that is held, and frees the former one.
  void Put(ScoreValue* value) {
    if (value != value_.get()) value_.reset(value);
    if (changed_ != nullptr) *changed_ = true;
  }

  /// From now on every change raises that flag, which must outlive this object.
  void Watch(bool* changed) { changed_ = changed; }

  /// `compare(own, other)` when both are there, else false.
  template <class Compare>
  bool Is(Compare compare, const ScoreValue* other) const {
    return value_ != nullptr && other != nullptr && compare(*value_, *other);
  }

 private:
  ScoreValue* NewCopy() const { return value_ == nullptr ? nullptr : value_->Clone(); }

  std::unique_ptr<ScoreValue> value_;
  bool* changed_ = nullptr;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_FILEDVALUE_H
