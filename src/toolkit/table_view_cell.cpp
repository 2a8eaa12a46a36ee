#include "toolkit/table_view_cell.h"

namespace vesk {

void TableViewCell::prepareForReuse() {
  mainText_.reset();
  detailText_.reset();
}

}  // namespace vesk
