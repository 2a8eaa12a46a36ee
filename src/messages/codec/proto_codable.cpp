#include "messages/codec/proto_codable.h"

#include "platform/text_form.h"

namespace vesk {

std::string ProtoCodable::description() const {
  std::string text = "<";
  text += className();
  text += "> ";
  appendText(text, dictionaryRepresentation());
  return text;
}

}  // namespace vesk
