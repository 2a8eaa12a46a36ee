#include "app/program/app_id_validator.h"

#include "corvik/constants.h"

namespace vesk {

bool AppIDValidator::isForThisApplication(const Dictionary& event) {
  const Value* found = event.find(corvik::kKeyAppID);
  appID_ = found == nullptr ? std::nullopt : found->integer();
  return appID_ == myAppID;
}

}  // namespace vesk
