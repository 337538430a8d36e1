// The input values of one case (one row) to be scored.

#ifndef KESTREL_DICTIONARY_SCORECASERECORD_H
#define KESTREL_DICTIONARY_SCORECASERECORD_H

#include <cstddef>
#include <iosfwd>
#include <string>
#include <vector>

#include "kestrel/foundation/DateTimeType.h"
#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

class ScoreDictVar;

/// One value per variable, reached by position (from 0) or by exact, case-sensitive name. The record owns its
/// values.
///
/// A record belongs to one scoring call at a time; nothing is locked.
class KESTREL_API ScoreCaseRecord {
 public:
  virtual ~ScoreCaseRecord();

  /// Puts a value (null for an empty slot) under a name and takes ownership of it. A new name gets the next
  /// position. Under a known name the value replaces what the slot held, which is not deleted: it is the
  /// caller's from then on.
  virtual void Add(const std::string& name, ScoreValue* value) = 0;

  /// Writes a text into a slot that is empty or holds a text. False, and nothing changes, when there is no
  /// such slot or it holds a number or a date/time.
  virtual bool SetValue(int index, const std::string& text) = 0;
  virtual bool SetValue(const std::string& name, const std::string& text) = 0;
  /// Writes a date/time, given in the unit of `type`, into a slot that is empty or holds a date/time. False,
  /// and nothing changes, when there is no such slot or it holds something else.
  virtual bool SetValue(int index, double value, DateTimeType type) = 0;
  virtual bool SetValue(const std::string& name, double value, DateTimeType type) = 0;
  /// Writes a number into a slot that is empty or holds a number. False, and nothing changes, when there is
  /// no such slot or it holds something else.
  virtual bool SetValue(int index, double value) = 0;
  virtual bool SetValue(const std::string& name, double value) = 0;

  /// Makes the value in a slot missing: the system-missing number for a number or date/time, the empty text
  /// for a text. False when there is no such slot or it is empty.
  virtual bool SetMissingValue(int index) = 0;
  virtual bool SetMissingValue(const std::string& name) = 0;

  /// Deletes the value under a name and leaves its slot empty; the name keeps its position. Unknown names are
  /// ignored.
  virtual void Remove(const std::string& name) = 0;

  /// The value in a slot, still owned by the record; null when there is no such slot or it is empty.
  virtual const ScoreValue* Get(int index) const = 0;
  virtual const ScoreValue* Get(const std::string& name) const = 0;

  /// Reserves room for as many values as there are names or variables. Names enter a record through `Add`
  /// alone.
  virtual void SetUpNameIndexMap(const std::vector<std::string>& names) = 0;
  virtual void SetUpNameIndexMap(const std::vector<ScoreDictVar*>& vars) = 0;
  /// Always true.
  virtual bool HasMap() const = 0;

  /// The position of a name, or -1.
  virtual int GetIndex(const std::string& name) const = 0;
  /// The number of slots.
  virtual std::size_t Size() const = 0;
  /// The names in ascending (byte-wise) order, not in order of position, followed by empty texts up to
  /// `Size()`.
  virtual std::vector<std::string> GetVarNames() const = 0;
  /// The slots by position, null where empty; the values stay owned by the record.
  virtual const std::vector<ScoreValue*>& GetAllValues() const = 0;
  virtual void Display(std::ostream& os) const = 0;

  /// Two records that give the same stamp, other than 0, have the same names at the same positions. A model
  /// keeps the positions that it looked up for a stamp and asks again only when it meets another one. 0 says
  /// that nothing is promised and positions are to be looked up for each case.
  virtual unsigned long long GetLayoutStamp() const { return 0; }
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_SCORECASERECORD_H
