#include "messages/codec/proto_codable.h"

#include "values/text_form.h"

namespace vesk {

void ProtoCodable::appendJson(std::string& out) const {
  JsonWriter json(out);
  writeJson(json);
  json.finish();
}

std::string ProtoCodable::description() const {
  std::string text = "<";
  text += className();
  text += "> ";
  appendText(text, dictionaryRepresentation());
  return text;
}

}  // namespace vesk
