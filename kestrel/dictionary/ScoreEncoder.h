// Turns a variable's values into small integer codes and back.

#ifndef KESTREL_DICTIONARY_SCOREENCODER_H
#define KESTREL_DICTIONARY_SCOREENCODER_H

#include <iosfwd>
#include <string>
#include <vector>

#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// What every encoder offers. Codes are dense and start at 0.
///
/// `Encode` may register a new value and must not run beside any other call on the same encoder. Everything
/// const only reads and is safe on several threads at once.
class KESTREL_API ScoreEncoder {
 public:
  enum EncoderType : int { kBinning = 1, kCatNumeric = 2, kCatString = 3 };

  virtual ~ScoreEncoder();

  virtual EncoderType GetEncoderType() const = 0;
  /// The number of codes in use.
  virtual int GetNumberOfCategories() const = 0;
  /// The value's code; a categorical encoder registers a value that it does not know yet. -1 for null.
  virtual int Encode(const ScoreValue* value) = 0;
  virtual int Encode(const std::string& text) = 0;
  /// The value's code, or -1 when it has none. Registers nothing.
  virtual int EncodeConst(const std::string& text) const = 0;
  virtual int EncodeConst(const ScoreValue* value) const = 0;
  /// The text registered under a code; empty when the code is out of range or stands for no text.
  virtual std::string Decode(int code) const = 0;
  /// The number registered under a code; the system-missing value when the code is out of range or stands for
  /// no number.
  virtual double DecodeNum(int code) const = 0;
  /// A deep copy, owned by the caller.
  virtual ScoreEncoder* Clone() const = 0;

  /// Replaces the display labels, one per code. They are optional and play no part in encoding.
  virtual void SetValueLabels(const std::vector<std::string>& labels) = 0;
  /// Sets the label of one code, adding empty labels below it as needed. A code outside the categories and
  /// the labels set so far is ignored.
  virtual void SetValueLabel(int code, const std::string& label) = 0;
  /// The labels by code, owned by the encoder; may be shorter than the number of categories. Never null.
  virtual const std::vector<std::string>* GetValueLabels() const = 0;
  virtual void Display(std::ostream& os) const = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_SCOREENCODER_H
