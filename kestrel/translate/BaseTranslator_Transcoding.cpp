// The translator's transcoder, for documents whose texts a plug-in wants in one encoding.

#include <utility>

#include "kestrel/foundation/PliantTranscoder.h"
#include "kestrel/translate/BaseTranslator.h"
#include "kestrel/translate/ParserPlatform.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

void BaseTranslator::CreateTranscoder(const std::string& encoding) {
  RequireParser();  // transcoders are the parser library's
  const std::string name = encoding.empty() ? "CP1252" : encoding;
  auto transcoder = std::make_shared<MCXML_800::PliantTranscoder>(name);
  // With a transcoder that converts nothing every text of the document would read as empty.
  if (!transcoder->IsValid()) Fail(KestrelException::kUnsupported, name + ": Not supported!");
  transcoder_ = std::move(transcoder);
}

MCXML_800::PliantTranscoder* BaseTranslator::GetTranscoder() const {
  return transcoder_.get();
}

bool BaseTranslator::IsEqual(MCXML_800::PliantTranscoder* transcoder, const XMLCh* wide,
                             const std::string& narrow) {
  if (transcoder == nullptr) return IsEqual(wide, narrow);
  std::string text;
  if (!IsEmpty(wide)) transcoder->transcodeTo(wide, text);
  return text == narrow;
}

}  // namespace MCKestrel_800
