#include "Foundation/archive/ArchiveWriter.h"

#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/archive/ReferenceDate.h"

namespace plume {

namespace {

constexpr std::int64_t ArchiveVersion = 100000;
constexpr ArchiveWriter::Class DateClass{"NSDate"};
constexpr ArchiveWriter::Class DictionaryClass{"NSDictionary"};
constexpr ArchiveWriter::Class MutableDictionaryClass{"NSMutableDictionary", "NSDictionary"};

}  // namespace

ArchiveWriter::Fields& ArchiveWriter::Fields::put(std::string_view key, Value value) {
    entries_.emplace_back(writer_.values_.ascii(key), value);
    return *this;
}

ArchiveWriter::Fields& ArchiveWriter::Fields::refer(std::string_view key, Object object) {
    return put(key, writer_.reference(object));
}

ArchiveWriter::ArchiveWriter() {
    objects_.push_back(values_.ascii("$null"));
}

ArchiveWriter::Object ArchiveWriter::add(Value value) {
    if (value >= objectOf_.size()) objectOf_.resize(values_.count() * 2);
    Object& object = objectOf_[value];
    if (object == 0) {
        object = static_cast<Object>(objects_.size());
        objects_.push_back(value);
    }
    return object;
}

ArchiveWriter::Object ArchiveWriter::add(const Class& itsClass, Fields& fields) {
    return add(fieldsOf(itsClass, fields));
}

ArchiveWriter::Object ArchiveWriter::reserve() {
    objects_.push_back(objects_.front());
    return static_cast<Object>(objects_.size() - 1);
}

void ArchiveWriter::fill(Object object, const Class& itsClass, Fields& fields) {
    objects_[object] = fieldsOf(itsClass, fields);
}

ArchiveWriter::Value ArchiveWriter::fieldsOf(const Class& itsClass, Fields& fields) {
    fields.put("$class", classReference(itsClass));
    return values_.dictionary(fields.entries_.data(), fields.entries_.size());
}

ArchiveWriter::Value ArchiveWriter::classReference(const Class& itsClass) {
    const auto known = classes_.find(itsClass.name);
    if (known != classes_.end()) return known->second;
    const Value name = values_.ascii(itsClass.name);
    std::vector<Value> chain{name};
    if (!itsClass.parent.empty()) chain.push_back(values_.ascii(itsClass.parent));
    chain.push_back(values_.ascii("NSObject"));
    Fields fields(*this);
    fields.put("$classname", name).put("$classes", values_.array(chain));
    const Object object = add(values_.dictionary(fields.entries_.data(), fields.entries_.size()));
    return classes_.emplace(itsClass.name, reference(object)).first->second;
}

ArchiveWriter::Object ArchiveWriter::addDate(Date date) {
    Fields fields(*this);
    return add(DateClass, fields.put("NS.time", values_.real(referenceSeconds(date))));
}

ArchiveWriter::Value ArchiveWriter::references(const std::vector<Object>& objects) {
    std::vector<Value> values;
    values.reserve(objects.size());
    for (const Object object : objects) values.push_back(reference(object));
    return values_.array(values);
}

ArchiveWriter::Object ArchiveWriter::addArray(const Class& itsClass, const std::vector<Object>& elements) {
    Fields fields(*this);
    return add(itsClass, fields.put("NS.objects", references(elements)));
}

void ArchiveWriter::fillArray(Object object, const Class& itsClass, const std::vector<Object>& elements) {
    Fields fields(*this);
    fill(object, itsClass, fields.put("NS.objects", references(elements)));
}

ArchiveWriter::Fields ArchiveWriter::fieldsOfDictionary(const std::vector<std::pair<Object, Object>>& entries) {
    std::vector<Object> keys;
    std::vector<Object> elements;
    for (const auto& [key, element] : entries) {
        keys.push_back(key);
        elements.push_back(element);
    }
    Fields fields(*this);
    fields.put("NS.keys", references(keys)).put("NS.objects", references(elements));
    return fields;
}

ArchiveWriter::Object ArchiveWriter::addDictionary(const std::vector<std::pair<Object, Object>>& entries) {
    Fields fields = fieldsOfDictionary(entries);
    return add(DictionaryClass, fields);
}

void ArchiveWriter::fillDictionary(Object object, const std::vector<std::pair<Object, Object>>& entries) {
    Fields fields = fieldsOfDictionary(entries);
    fill(object, MutableDictionaryClass, fields);
}

ArchiveWriter::Object ArchiveWriter::addPropertyList(const PropertyList& list) {
    if (const auto* flag = list.as<bool>()) return add(values_.boolean(*flag));
    if (const auto* integer = list.as<std::int64_t>()) return add(values_.integer(*integer));
    if (const auto* real = list.as<double>()) return add(values_.real(*real));
    if (const auto* text = list.as<std::u16string>()) return addString(*text);
    if (const auto* date = list.as<Date>()) return addDate(*date);
    if (const auto* data = list.as<ArchivedData>()) return add(values_.data(data->bytes));
    if (const auto* array = list.as<PropertyList::Array>()) {
        std::vector<Object> elements;
        for (const PropertyList& element : *array) {
            if (const Object object = addPropertyList(element)) elements.push_back(object);
        }
        return addArray(archived::Array, elements);
    }
    const auto* dictionary = list.as<PropertyList::Dictionary>();
    if (!dictionary) return 0;
    std::vector<std::pair<Object, Object>> entries;
    for (const auto& [key, element] : *dictionary) {
        if (const Object object = addPropertyList(element)) entries.emplace_back(addString(fromUtf8(key)), object);
    }
    return addDictionary(entries);
}

std::string ArchiveWriter::finish(Object root) {
    Fields top(*this);
    top.refer("root", root);
    Fields archive(*this);
    archive.put("$version", values_.integer(ArchiveVersion))
        .put("$archiver", values_.ascii("NSKeyedArchiver"))
        .put("$top", values_.dictionary(top.entries_.data(), top.entries_.size()))
        .put("$objects", values_.array(objects_));
    return values_.finish(values_.dictionary(archive.entries_.data(), archive.entries_.size()));
}

}  // namespace plume
