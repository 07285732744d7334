#include "screens/tv/reading.h"

#include <QAccessibleObject>
#include <QQuickItem>
#include <QQuickWindow>
#include <algorithm>

namespace wp::tv {
namespace {

constexpr const char* kIsUsable = "isUsable";
constexpr const char* kPercentage = "percentage";

/// The item's `Accessible`: an object of the toolkit's own that belongs to the item. Null without it.
QObject* attachedTo(const QQuickItem& item) {
    const QObjectList& parts = item.children();
    auto found = std::find_if(parts.begin(), parts.end(),
                              [](QObject* part) { return part->inherits("QQuickAccessibleAttached"); });
    return found == parts.end() ? nullptr : *found;
}

class Reading final : public QAccessibleObject, public QAccessibleValueInterface {
  public:
    Reading(QQuickItem& item, QObject& attached)
        : QAccessibleObject(&item), item_(item), attached_(attached) {}

    QAccessibleInterface* parent() const override {
        for (QQuickItem* outer = item_.parentItem(); outer; outer = outer->parentItem())
            if (QAccessibleInterface* told = QAccessible::queryAccessibleInterface(outer)) return told;
        return QAccessible::queryAccessibleInterface(item_.window());
    }
    int childCount() const override { return 0; }
    QAccessibleInterface* child(int) const override { return nullptr; }
    int indexOfChild(const QAccessibleInterface*) const override { return -1; }
    QWindow* window() const override { return item_.window(); }

    QString text(QAccessible::Text kind) const override {
        if (kind == QAccessible::Name) return attached_.property("name").toString();
        return kind == QAccessible::Description ? attached_.property("description").toString() : QString();
    }
    QRect rect() const override {
        if (!item_.window()) return {};
        QRect inWindow = item_.mapRectToScene(item_.boundingRect()).toRect();
        return {item_.window()->mapToGlobal(inWindow.topLeft()), inWindow.size()};
    }
    QAccessible::Role role() const override {
        return static_cast<QAccessible::Role>(attached_.property("role").toInt());
    }
    QAccessible::State state() const override {
        QAccessible::State state;
        state.focusable = attached_.property("focusable").toBool();
        state.focused = attached_.property("focused").toBool();
        state.disabled = item_.property(kIsUsable) == QVariant(false);
        state.invisible = !item_.isVisible() || item_.opacity() == 0;
        return state;
    }

    void* interface_cast(QAccessible::InterfaceType type) override {
        bool hasValue = type == QAccessible::ValueInterface && currentValue().isValid();
        return hasValue ? static_cast<QAccessibleValueInterface*>(this) : nullptr;
    }
    QVariant currentValue() const override { return item_.property(kPercentage); }
    void setCurrentValue(const QVariant&) override {}
    QVariant minimumValue() const override { return 0; }
    QVariant maximumValue() const override { return 100; }
    QVariant minimumStepSize() const override { return 1; }

  private:
    QQuickItem& item_;
    QObject& attached_;
};

QAccessibleInterface* readingOf(const QString&, QObject* object) {
    auto* item = qobject_cast<QQuickItem*>(object);
    if (!item || !(item->property(kIsUsable).isValid() || item->property(kPercentage).isValid()))
        return nullptr;
    QObject* attached = attachedTo(*item);
    return attached ? new Reading(*item, *attached) : nullptr;
}

}  // namespace

void installReading() {
    QAccessible::installFactory(readingOf);
}

}  // namespace wp::tv
