#include "screens/tv/table_model.h"

#include <algorithm>

namespace wp::tv {
namespace {

std::size_t at(int number) {
    return static_cast<std::size_t>(number);
}

}  // namespace

int TableModel::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(entries_.size());
}

QVariant TableModel::data(const QModelIndex& index, int role) const {
    if (!checkIndex(index, CheckIndexOption::IndexIsValid)) return {};
    const Entry& entry = entries_[at(index.row())];
    switch (role) {
        case idRole:
            return entry.id;
        case textRole:
            return QString::fromStdString(entry.line.text);
        case detailRole:
            return QString::fromStdString(entry.line.detail);
        case isBlockRole:
            return entry.line.isBlock;
        case isHeaderRole:
            return entry.line.isHeader();
        case isEnabledRole:
            return entry.line.isEnabled;
        case isFirstRole:
            return entry.line.isFirst;
        case isLastRole:
            return entry.line.isLast;
        case topRole:
            return entry.line.top;
        case heightRole:
            return entry.line.height;
        case isFocusedRole:
            return entry.isFocused;
        case isNewRole:
            return entry.isNew;
        case isLeavingRole:
            return entry.isLeaving;
        default:
            return {};
    }
}

QHash<int, QByteArray> TableModel::roleNames() const {
    return {{idRole, "lineId"},          {textRole, "text"},           {detailRole, "detail"},
            {isBlockRole, "isBlock"},    {isHeaderRole, "isHeader"},   {isEnabledRole, "isEnabled"},
            {isFirstRole, "isFirst"},    {isLastRole, "isLast"},       {topRole, "lineTop"},
            {heightRole, "lineHeight"},  {isFocusedRole, "isFocused"}, {isNewRole, "isNew"},
            {isLeavingRole, "isLeaving"}};
}

void TableModel::setWindow(double top, double height) {
    if (windowTop_ == top && windowHeight_ == height) return;
    windowTop_ = top;
    windowHeight_ = height;
    stage({});
}

void TableModel::play(const std::vector<Line>& lines, const LineChanges& changes, Motion motion) {
    for (int removal : changes.removals) {
        leave(ids_[at(removal)], motion);
        ids_.erase(ids_.begin() + removal);
    }
    std::vector<int> newIds;
    for (int insertion : changes.insertions) {
        ids_.insert(ids_.begin() + insertion, ++lastId_);
        if (motion == Motion::full) newIds.push_back(lastId_);
    }
    lines_ = lines;
    stage(newIds);
}

void TableModel::setFocused(std::optional<ui::IndexPath> focused) {
    focused_ = focused;
    for (std::size_t position = 0; position < entries_.size(); ++position)
        if (!entries_[position].isLeaving) update(position, entries_[position].line);
}

void TableModel::release(int id) {
    // Its item is in the middle of telling us.
    QMetaObject::invokeMethod(
        this,
        [this, id] {
            for (std::size_t position = 0; position < entries_.size(); ++position)
                if (entries_[position].id == id && entries_[position].isLeaving) return removeEntry(position);
        },
        Qt::QueuedConnection);
}

bool TableModel::hasLeaving() const {
    return std::any_of(entries_.begin(), entries_.end(), [](const Entry& entry) { return entry.isLeaving; });
}

/// A screenful above and below is kept ready, so that scrolling finds its lines there.
bool TableModel::isInWindow(const Line& line) const {
    return line.top + line.height >= windowTop_ - windowHeight_ && line.top <= windowTop_ + 2 * windowHeight_;
}

bool TableModel::isFocused(const Line& line) const {
    return focused_ && *focused_ == ui::IndexPath{line.row, line.section};
}

/// Brings the entries that are not leaving in line with the lines of the window. Both are in one order.
void TableModel::stage(const std::vector<int>& newIds) {
    std::size_t position = 0;
    auto skipLeaving = [&] {
        while (position < entries_.size() && entries_[position].isLeaving) ++position;
    };
    for (std::size_t now = 0; now < lines_.size(); ++now) {
        skipLeaving();
        bool isStaged = position < entries_.size() && entries_[position].id == ids_[now];
        if (!isInWindow(lines_[now])) {
            if (isStaged) removeEntry(position);
        } else if (isStaged) {
            update(position++, lines_[now]);
        } else {
            bool isNew = std::find(newIds.begin(), newIds.end(), ids_[now]) != newIds.end();
            int row = static_cast<int>(position);
            beginInsertRows({}, row, row);
            entries_.insert(entries_.begin() + row, {ids_[now], lines_[now], isFocused(lines_[now]), isNew});
            endInsertRows();
            ++position;
        }
    }
}

void TableModel::leave(int id, Motion motion) {
    for (std::size_t position = 0; position < entries_.size(); ++position) {
        Entry& entry = entries_[position];
        if (entry.id != id || entry.isLeaving) continue;
        if (motion == Motion::none) return removeEntry(position);
        entry.isLeaving = true;
        entry.isFocused = false;
        QModelIndex changed = createIndex(static_cast<int>(position), 0);
        emit dataChanged(changed, changed, {isLeavingRole, isFocusedRole});
        return;
    }
}

void TableModel::removeEntry(std::size_t position) {
    int row = static_cast<int>(position);
    beginRemoveRows({}, row, row);
    entries_.erase(entries_.begin() + row);
    endRemoveRows();
}

void TableModel::update(std::size_t position, const Line& line) {
    Entry& entry = entries_[position];
    bool isNowFocused = isFocused(line);
    if (entry.line == line && entry.isFocused == isNowFocused) return;
    entry.line = line;
    entry.isFocused = isNowFocused;
    QModelIndex changed = createIndex(static_cast<int>(position), 0);
    emit dataChanged(changed, changed);
}

}  // namespace wp::tv
