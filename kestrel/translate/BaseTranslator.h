// The common base of translators: finding children and attributes, and checking and converting attribute
// texts.

#ifndef KESTREL_TRANSLATE_BASETRANSLATOR_H
#define KESTREL_TRANSLATE_BASETRANSLATOR_H

#include <xercesc/util/XercesDefs.hpp>

#include <iosfwd>
#include <memory>
#include <string>

#include "kestrel/foundation/DateTimeType.h"
#include "kestrel/platform/Export.h"
#include "kestrel/translate/ScoreTranslator.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMDocument;
class DOMNode;
class DOMNodeList;
XERCES_CPP_NAMESPACE_END

namespace MCXML_800 {
class PliantTranscoder;
}

namespace MCKestrel_800 {

class ScoreDictVar;
class ScoreValue;

/// Base of every translator: static helpers over the tree, and null for the forms that a plug-in does not
/// offer.
///
/// "Text" arguments called narrow are UTF-8 (on Windows the process's code page unless UTF-8 mode is on).
/// Every helper that returns a node or a wide text returns something that belongs to the document. Errors:
/// KestrelException as stated at each helper, with the element's line and column where they are known.
/// Threads: the static helpers keep no state.
class KESTREL_API BaseTranslator : public ScoreTranslator {
 public:
  BaseTranslator();
  // A copy shares the transcoder, which goes when its last holder does.
  BaseTranslator(const BaseTranslator& other);
  BaseTranslator& operator=(const BaseTranslator& other);
  ~BaseTranslator() override;

  ScoreModel* ParseFromTree(xercesc::DOMElement* modelElement, xercesc::DOMElement* otherElement,
                            const std::string& arg) override;
  ScoreModel* ParseFromTree(xercesc::DOMElement* modelElement, ScoreDictionary* dictionary,
                            ScoreDictionary* resultDictionary, const std::string& arg) override;
  ScoreModel* ParseFromTree(const std::string& fileName, const std::string& arg) override;
  ScoreModel* ParseFromTree(std::istream& in, const std::string& arg) override;
  ScoreModel* ParseFromTree(xercesc::DOMElement* root, const std::string& arg) override = 0;
  /// A stream with two arguments of the host's; null unless a plug-in offers it.
  virtual ScoreModel* ParseFromTree(std::istream& in, const std::string& arg, const std::string& secondArg);

  /// Gives the translator a transcoder for `encoding`, or for "CP1252" when it is empty. Replaces the one
  /// before. Code 5 for an encoding that PliantTranscoder does not know; the one before then stays.
  void CreateTranscoder(const std::string& encoding);
  /// The transcoder, or null before CreateTranscoder. It belongs to the translator.
  MCXML_800::PliantTranscoder* GetTranscoder() const;

  /// Removes leading blanks (spaces alone). Trailing blanks go only when there were no leading ones, which
  /// documents in use rely on; a text of blanks alone comes back unchanged.
  static std::string TrimBlanks(const std::string& text);

  /// Whether a wide and a narrow text are the same: compared as narrow text with a transcoder, as wide text
  /// without.
  static bool IsEqual(MCXML_800::PliantTranscoder* transcoder, const XMLCh* wide, const std::string& narrow);
  static bool IsEqual(const XMLCh* wide, const std::string& narrow);

  /// The first child, or next sibling, that is an element; null if there is none or `node` is null.
  static xercesc::DOMNode* GetFirstChildElt(xercesc::DOMNode* node);
  static xercesc::DOMNode* GetNextSiblingElt(xercesc::DOMNode* node);

  /// The first child element with the tag; null if there is none or `node` is null.
  static xercesc::DOMNode* GetChildByTag(xercesc::DOMNode* node, const std::string& tag);
  /// The same with a wide tag, which is released before returning: it must come from XMLString::transcode or
  /// replicate.
  static xercesc::DOMNode* GetChildTag(xercesc::DOMNode* node, XMLCh* tag);
  /// The same, throwing code 4 where there is none: "Node is missing --- tag ---".
  static xercesc::DOMNode* GetChildByTagForced(xercesc::DOMNode* node, const std::string& tag);
  /// The same with a wide tag, released on every way out; here the message starts with the tag.
  static xercesc::DOMNode* GetChildTagForced(xercesc::DOMNode* node, XMLCh* tag);

  /// All descendants with the tag, as a live list that belongs to the document. Null throws code 4.
  static xercesc::DOMNodeList* GetElementsByTagName(const xercesc::DOMDocument* document,
                                                    const std::string& tag);
  static xercesc::DOMNodeList* GetElementsByTagName(const xercesc::DOMElement* element,
                                                    const std::string& tag);

  /// An attribute's value; the empty text when it is absent or `element` is null.
  static const XMLCh* GetAttribute(const xercesc::DOMElement* element, const std::string& name);
  /// An attribute's value; code 4 when it is absent.
  static const XMLCh* GetAttributeForced(const xercesc::DOMElement* element, const std::string& name);

  /// An integer: digits with at most one sign in front, nothing trimmed. What int cannot hold is clamped.
  /// Code 3 for anything else, null included.
  static int VerifyInt(const std::string& text);
  static int VerifyInt(const XMLCh* text);

  /// A decimal number, blanks trimmed as TrimBlanks does. Too large is an infinity. Code 3 for anything else,
  /// null included.
  static double VerifyDouble(const std::string& text);
  static double VerifyDouble(const XMLCh* text);

  /// The number of a date/time text of the type: seconds, as DateTimeValue::GetDouble gives them. Code 3 when
  /// the text is not of the type.
  static double VerifyDateTime(const std::string& text, DateTimeType type);
  static double VerifyDateTime(const XMLCh* text, DateTimeType type);

  /// A new value of the variable's storage type that the caller deletes; null for another type and for a null
  /// variable. Code 3 for a text that is not a number where one is needed.
  static ScoreValue* CarefullyMakeVarValue(const ScoreDictVar* var, const std::string& text);
  static ScoreValue* CarefullyMakeVarValue(const ScoreDictVar* var, const XMLCh* text);

 private:
  // Held shared, because an assigned translator works with the other's transcoder and neither may delete it
  // twice.
  std::shared_ptr<MCXML_800::PliantTranscoder> transcoder_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_BASETRANSLATOR_H
