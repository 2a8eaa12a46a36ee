#pragma once

#include "support/fake_interface.h"

namespace vesk {

/// Values as no metric should have them.
class OddFields : public FakeTableScreen {
 public:
  OddFields() {
    content = {{"many"_text, {}}, {std::nullopt, {}}, {"odd"_text, {}}};
    for (int index = 0; index < 30; ++index)
      content[0].rows.push_back(row("row " + std::to_string(index), "1"));
    content[2].rows = {
        row("lines", "first\nsecond \x1B[31m\n\n- third"),
        row("", ""),
        row(std::string(300, 'k'), std::string(2000, 'v')),
        row("漢字漢字", "e\u0301\u202E📶\xC3\x80\xFF\t\x9B"),
        {std::nullopt, "alone"_text},
    };
  }
};

/// Areas, then categories, then those fields.
inline const InterfaceLayout& oddInterface() {
  static const InterfaceLayout theLayout({
      .rootStack = makeStackOf<NavigationController>,
      .firstScreen = "Areas",
      .screens = {{"Areas", makeScreenOf<FakeAreas>, "Vesk"},
                  {"Categories", makeScreenOf<FakeCategories>, ""},
                  {"Fields", makeScreenOf<OddFields>, ""}},
      .cells = {{"LaunchView", CellStyle::Basic, CellAccessory::Disclosure},
                {"FirstClickView", CellStyle::Basic, CellAccessory::Disclosure},
                {"SecondClickView", CellStyle::RightDetail, CellAccessory::None}},
      .transitions = {{"Areas", "showArea", "Categories"}, {"Categories", "showCategory", "Fields"}},
  });
  return theLayout;
}

}  // namespace vesk
