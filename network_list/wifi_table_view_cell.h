#pragma once

#include <string>
#include <utility>

#include "platform/ui/table_view_cell.h"

namespace wp {

/// A row with its title on the left and a detail on the right, whatever style it is asked for. *Main*.
class WiFiTableViewCell final : public ui::TableViewCell {
  public:
    WiFiTableViewCell(Style, std::string reuseIdentifier)
        : TableViewCell(Style::value1, std::move(reuseIdentifier)) {}
};

}  // namespace wp
