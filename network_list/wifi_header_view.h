#pragma once

#include <memory>
#include <string>

#include "platform/ui/controls.h"
#include "platform/ui/label.h"

namespace wp {

/// A header for a section of the list: a text and, where asked for, an activity indicator beside it. *Main*.
class WiFiHeaderView final : public ui::View {
  public:
    WiFiHeaderView(ui::Rect frame, const std::string& text, bool showSpinner);

    const std::shared_ptr<ui::Label>& headerText() const { return headerText_; }
    /// Null where none was asked for.
    const std::shared_ptr<ui::ActivityIndicator>& spinner() const { return spinner_; }

    void layoutSubviews() override;

  private:
    std::shared_ptr<ui::Label> headerText_;
    std::shared_ptr<ui::ActivityIndicator> spinner_;
};

}  // namespace wp
