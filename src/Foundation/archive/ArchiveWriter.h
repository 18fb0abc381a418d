// Puts objects into a keyed archive, in the layout of the platform that such archives come from.
//
// Values are what a property list is made of; an object has a place in the archive's list of objects, by which others
// refer to it. What cannot be changed by those who read it (strings, numbers, dates, fonts) is there once, however
// often it is added. One of these, one thread.
#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "Foundation/Date.h"
#include "Foundation/archive/BinaryObjectWriter.h"
#include "Foundation/archive/PropertyList.h"

namespace plume {

class ArchiveWriter {
  public:
    using Value = BinaryObjectWriter::Number;
    using Object = std::uint32_t;

    // What classes an object belongs to, besides NSObject.
    struct Class {
        std::string_view name;
        std::string_view parent = {};
    };

    // The keys and values of one object; those that are left out are as in a new object.
    class Fields {
      public:
        explicit Fields(ArchiveWriter& writer) : writer_(writer) {}
        Fields& put(std::string_view key, Value value);
        Fields& refer(std::string_view key, Object object);

      private:
        friend class ArchiveWriter;
        ArchiveWriter& writer_;
        std::vector<BinaryObjectWriter::Entry> entries_;
    };

    ArchiveWriter();

    BinaryObjectWriter& values() { return values_; }

    // A string, a number or data that stands bare in the list.
    Object add(Value value);
    // An object that is the same for everyone.
    Object add(const Class& itsClass, Fields& fields);
    // A place for an object that is filled in later.
    Object reserve();
    void fill(Object object, const Class& itsClass, Fields& fields);

    Object addString(std::u16string_view text) { return add(values_.string(text)); }
    Object addDate(Date date);
    Object addArray(const Class& itsClass, const std::vector<Object>& elements);
    Object addDictionary(const std::vector<std::pair<Object, Object>>& entries);
    // 0, nil, for a value that has no place in archives.
    Object addPropertyList(const PropertyList& list);
    // Fill in an array or dictionary that can be changed.
    void fillArray(Object object, const Class& itsClass, const std::vector<Object>& elements);
    void fillDictionary(Object object, const std::vector<std::pair<Object, Object>>& entries);

    // The archive whose outermost object is this one.
    std::string finish(Object root);

  private:
    Value reference(Object object) { return values_.uid(object); }
    Value references(const std::vector<Object>& objects);
    Value fieldsOf(const Class& itsClass, Fields& fields);
    Value classReference(const Class& itsClass);
    Fields fieldsOfDictionary(const std::vector<std::pair<Object, Object>>& entries);

    BinaryObjectWriter values_;
    std::vector<Value> objects_;
    std::vector<Object> objectOf_;  // by value; 0 for those that are no object yet
    std::map<std::string_view, Value> classes_;
};

namespace archived {

inline constexpr ArchiveWriter::Class Array{"NSArray"};
inline constexpr ArchiveWriter::Class MutableArray{"NSMutableArray", "NSArray"};

}  // namespace archived

}  // namespace plume
