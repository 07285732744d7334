#include "host/automation_file.h"

#include "platform/json_writer.h"

namespace wp::host {

void AutomationFile::postConfiguration(DictionaryPointer configuration) {
    posted_ += jsonText(configuration, JSONStyle::indented) + "\n";
}

void AutomationFile::write() const {
    if (file_ && !posted_.empty()) file_->write(posted_);
}

}  // namespace wp::host
