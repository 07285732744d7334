#pragma once

#include <concepts>
#include <cstdint>
#include <map>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

namespace wp {

class Dictionary;
class Value;

/// Base of the records that the platform's services hand out (`platform/records.h`). A record never changes
/// once it is shared, and two records are equal when they are the same object.
class Record {
  public:
    virtual ~Record() = default;

  protected:
    Record() = default;
    Record(const Record&) = default;
    Record& operator=(const Record&) = default;
};

/// The distinguished null object: a value that says "known to be nothing". It is not the lack of a key;
/// neither ever stands for the other.
struct NullMarker {
    friend bool operator==(NullMarker, NullMarker) = default;
};

/// A moment, in seconds since 2001-01-01 00:00:00 UTC.
struct Date {
    double secondsSinceReference = 0;
    friend bool operator==(Date, Date) = default;
};

/// An array is shared and does not change once it is in a value.
using Array = std::vector<Value>;
using ArrayPointer = std::shared_ptr<const Array>;
using DictionaryPointer = std::shared_ptr<Dictionary>;
using RecordPointer = std::shared_ptr<const Record>;

/// One entry of a document, a configuration or a service's information: a small value held directly, or an
/// array, dictionary or record held by reference, so that a copy of the value is the very same object. *Any*
/// thread.
class Value {
  public:
    using Storage = std::variant<NullMarker, bool, std::int64_t, std::uint64_t, double, std::string, Date,
                                 ArrayPointer, DictionaryPointer, RecordPointer>;

    Value() = default;
    Value(NullMarker) {}
    Value(std::same_as<bool> auto flag) : storage_(flag) {}
    Value(std::signed_integral auto number) : storage_(std::int64_t{number}) {}
    template <std::unsigned_integral T>
    requires(!std::same_as<T, bool>) Value(T number) : storage_(std::uint64_t{number}) {}
    Value(std::same_as<double> auto number) : storage_(number) {}
    Value(std::string text) : storage_(std::move(text)) {}
    Value(std::string_view text) : storage_(std::string(text)) {}
    Value(const char* text) : storage_(std::string(text)) {}
    Value(Date date) : storage_(date) {}
    Value(Array elements);
    Value(ArrayPointer elements) : storage_(std::move(elements)) {}
    Value(DictionaryPointer entries) : storage_(std::move(entries)) {}
    template <std::derived_from<Record> T>
    Value(std::shared_ptr<const T> record) : storage_(RecordPointer(std::move(record))) {}
    template <std::derived_from<Record> T>
    Value(std::shared_ptr<T> record) : storage_(RecordPointer(std::move(record))) {}

    const Storage& storage() const { return storage_; }
    bool isNull() const { return std::holds_alternative<NullMarker>(storage_); }

    /// The content as a `T` of the storage's alternatives; null where the value holds something else.
    template <class T>
    const T* as() const {
        return std::get_if<T>(&storage_);
    }

    /// The content as a record of the type `T`; null where the value holds something else.
    template <std::derived_from<Record> T>
    std::shared_ptr<const T> asRecord() const {
        const RecordPointer* record = as<RecordPointer>();
        return record ? std::dynamic_pointer_cast<const T>(*record) : nullptr;
    }

    /// Equal kind and content; arrays and dictionaries by their elements, records by identity.
    friend bool operator==(const Value& left, const Value& right);

  private:
    Storage storage_;
};

/// A mutable dictionary that is shared by reference. It is ordered by key. *Any* thread: every operation is
/// one indivisible step, because a result section may be written by two background blocks at once (a network
/// that is confirmed while the first scan still runs).
class Dictionary {
  public:
    using Entries = std::map<std::string, Value, std::less<>>;

    Dictionary() = default;
    explicit Dictionary(Entries entries) : entries_(std::move(entries)) {}
    Dictionary(const Dictionary&) = delete;
    Dictionary& operator=(const Dictionary&) = delete;

    /// A new dictionary with these entries.
    static DictionaryPointer make(Entries entries = {}) {
        return std::make_shared<Dictionary>(std::move(entries));
    }

    /// The value under the key, nothing where the key is absent.
    std::optional<Value> value(std::string_view key) const;
    /// Stores the value under the key, in place of an earlier one.
    void setValue(std::string_view key, Value value);
    /// Removes the key, if it is there.
    void removeValue(std::string_view key);
    std::size_t size() const;
    /// A snapshot of keys and values, ordered by key.
    Entries entries() const;

  private:
    mutable std::mutex mutex_;
    Entries entries_;
};

}  // namespace wp
