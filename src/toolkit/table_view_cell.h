#pragma once

#include <optional>

#include "toolkit/responder.h"
#include "values/text.h"

namespace vesk {

enum class CellStyle {
  Basic,        ///< the main text alone
  RightDetail,  ///< the main text at the left, the detail text at the right
};

/// The mark at the end of a row.
enum class CellAccessory { None, Disclosure };

/// One row as it is shown. A text that is absent was never set, which is not the same as an empty one.
class TableViewCell : public Responder {
 public:
  TableViewCell(Text reuseIdentifier, CellStyle style, CellAccessory accessory)
      : reuseIdentifier_(std::move(reuseIdentifier)), style_(style), accessory_(accessory) {}

  [[nodiscard]] const Text& reuseIdentifier() const { return reuseIdentifier_; }
  [[nodiscard]] CellStyle style() const { return style_; }
  [[nodiscard]] CellAccessory accessory() const { return accessory_; }

  [[nodiscard]] const std::optional<Text>& mainText() const { return mainText_; }
  void setMainText(std::optional<Text> text) { mainText_ = std::move(text); }
  [[nodiscard]] const std::optional<Text>& detailText() const { return detailText_; }
  void setDetailText(std::optional<Text> text) { detailText_ = std::move(text); }

  /// Called when the cell goes back to the reuse pool: both texts are absent again.
  void prepareForReuse();

 private:
  Text reuseIdentifier_;
  CellStyle style_;
  CellAccessory accessory_;
  std::optional<Text> mainText_;
  std::optional<Text> detailText_;
};

}  // namespace vesk
