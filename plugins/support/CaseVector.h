// From a host's case record to the flat vector of numbers that models compute with. All reading of records,
// all treatment of missing, invalid and outlying values and all coding of categories happens here, once per
// input.

#ifndef KESTREL_PLUGINS_SUPPORT_CASEVECTOR_H
#define KESTREL_PLUGINS_SUPPORT_CASEVECTOR_H

#include <cstddef>
#include <cstdint>
#include <limits>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "kestrel/foundation/NumericValue.h"
#include "plugins/support/MiningField.h"
#include "plugins/support/ValueRules.h"

namespace MCKestrel_800 {

class DerivedInputs;
class MiningSchema;
class ScoreCaseRecord;
class ScoreDictionary;
class TransformationDictionary;

/// The inputs of a model as slots, one double each.
///   A number slot holds the number itself (of a date/time the number in its field's unit) or the
///     system-missing value.
///   A category slot holds the category's code (see ValueRules), kMissingCategory, or kOtherCategory for a
///     value that has no code: valid in a field that lists no categories, or invalid and used as it is.
/// Values are treated as MiningSchema says. Two rules fill what it leaves open.
///   The empty text in a category slot is missing, rather than invalid, when the field lists categories and
///     it is not one of them: it is what ScoreCaseRecord::SetMissingValue leaves behind. So it is when a
///     derived field lists none.
///   An invalid value that a number slot uses as it is counts as the number that its text reads as, or as
///     missing when it reads as none.
///
/// A slot may hold a derived field: it is computed once a case (see DerivedInputs), and then its value is
/// treated like any other.
///
/// Building: AddNumber and AddCategory for each input that the model reads, in any order, repeated as it
/// likes; then Seal. Fields and their variables must outlive the vector. Afterwards Fill is called for each
/// case; it allocates nothing for the library's own numbers and texts and serves one case at a time.
class CaseVector {
 public:
  static constexpr double kMissingCategory = -2.0;
  static constexpr double kOtherCategory = -1.0;

  /// What Fill met, as bits.
  enum Outcome : unsigned {
    kComplete = 0,
    kMissingNumber = 1,  ///< a number slot holds the system-missing value
    kInvalidInput = 2    ///< a value makes the case invalid; the vector is not to be used
  };

  CaseVector();
  ~CaseVector();
  CaseVector(const CaseVector&) = delete;
  CaseVector& operator=(const CaseVector&) = delete;

  /// The slot that holds the field as a number; the field must not be a text. An input asked for twice is
  /// one slot.
  /// map_missing_to  takes the place of a value that is still missing after the field's own treatment; NaN
  ///                 for none.
  int AddNumber(const MiningField& field, double map_missing_to = std::numeric_limits<double>::quiet_NaN());

  /// The slot that holds the field as a category code. An input asked for twice is one slot.
  /// other_code  what stands for a value that has no code: kOtherCategory, or kMissingCategory for models
  /// that
  ///             make no difference.
  int AddCategory(const MiningField& field, double other_code = kOtherCategory);

  /// The code of a value in a category slot; see ValueRules::AddCategory.
  int AddCategoryValue(int slot, const ScoreValue& value);

  /// To be called once, after the last slot and category value. The form without arguments is for vectors
  /// without derived fields.
  /// schema   may be gone afterwards, but not its fields.
  /// data     the dictionary of the data fields; must outlive the vector.
  /// derived  the one of the derived fields, which computes them for this vector alone and must outlive it;
  ///          null when there are none.
  void Seal();
  void Seal(const MiningSchema& schema, const ScoreDictionary& data, TransformationDictionary* derived);

  /// The number of codes of a category slot, from 0.
  int GetCodeCount(int slot) const;

  int GetSlotCount() const { return static_cast<int>(slots_.size()); }

  /// Reads a case. Names that the record does not have are missing. The positions of the names are looked up
  /// again only when the record's layout stamp is another one than before, or 0. Returns the Outcome bits.
  unsigned Fill(const ScoreCaseRecord& record);

  /// The values by slot, as the last Fill left them.
  const double* GetValues() const { return values_.data(); }

  /// The variables of the data fields that are read from a case, each once, in the order in which they were
  /// first asked for; those that a derived field is computed from stand in its place. After Seal.
  std::vector<const ScoreDictVar*> GetPredictors() const;

  /// After Fill returned kInvalidInput: the position in GetPredictors() of the first field, by slot, whose
  /// value made the case invalid; first come those that derived fields read. For a derived field it is the
  /// position of the first field that it is computed from, or the number of predictors when there is none.
  int GetInvalidField() const;

 private:
  /// A number slot of a field whose numbers are all valid and none an outlier: what the loop over most slots
  /// reads.
  struct PlainSlot {
    std::size_t position;  ///< in the record
    std::size_t number;
    std::uint64_t missing_bits;  ///< of the value that takes the place of a missing one
  };
  struct Slot {
    const MiningField* field;
    ValueRules* rules;
    bool is_category;
    double map_missing_to;
    double other_code;
    int field_position;
    bool is_plain = false;
    bool is_text = false;
    bool has_outliers = false;
    ValueRules::Verdict verdict_of_missing_text = ValueRules::kInvalid;
    int position = -1;  ///< in the record; -1 when it does not have the name
    unsigned missing_outcome = kComplete;
    double missing_value = NumericValue::gSysmisValue;
    double invalid_value = NumericValue::gSysmisValue;
  };

  int AddSlot(const MiningField& field, bool is_category, double map_missing_to, double other_code);
  static void Prepare(Slot& slot);
  static double CodeValue(const Slot& slot, int code);
  void LookUpPositions(const ScoreCaseRecord& record);
  void PlaceSlots();
  unsigned FillWithDerived(const ScoreCaseRecord& record);
  const ScoreValue* const* GatherValues(const ScoreCaseRecord& record);
  unsigned FillFrom(const ScoreValue* const* record);
  const PlainSlot* CopyNumbers(const PlainSlot* slot, const ScoreValue* const* record,
                               const PlainSlot**& missing_end);
  unsigned FillTreated(int number, const ScoreValue* value);
  unsigned FillNumber(int number, double value);
  unsigned FillMissing(int number);
  unsigned FillInvalid(int number, const ScoreValue& value);
  unsigned RefuseCase(int number);

  std::vector<Slot> slots_;
  /// Of the record layout at hand: the plain slots whose names it has, and what those without add to each
  /// outcome.
  std::vector<PlainSlot> plain_slots_;
  unsigned absent_outcome_ = kComplete;
  /// The plain slots that are missing in the case at hand, with room for one more than there are.
  std::vector<const PlainSlot*> missing_slots_;
  std::vector<int> other_slots_;
  std::vector<double> values_;
  std::vector<const ScoreValue*> gathered_;  ///< by position, of a record without layout stamp
  std::vector<const MiningField*> fields_;
  std::vector<std::unique_ptr<ValueRules>> rules_;  ///< by field
  std::unique_ptr<DerivedInputs> derived_;          ///< null when no slot holds a derived field
  // Needed until Seal alone.
  std::map<std::string, int> slot_numbers_;
  std::map<const MiningField*, int> field_positions_;
  unsigned long long layout_stamp_ = 0;
  int positions_end_ = 0;
  int invalid_slot_ = 0;
  static constexpr int kNoSlot = -1;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_CASEVECTOR_H
