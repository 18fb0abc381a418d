// Date and time placeholders: the present moment, shifted, in a style or pattern of a locale.
#pragma once

#include <cstdint>
#include <string>

#include "Foundation/Date.h"
#include "content/ContentEnvironment.h"
#include "content/SnippetVariable.h"

namespace plume {

class SnippetDateTimeVariable : public SnippetVariable {
  public:
    using SnippetVariable::SnippetVariable;

    // The formatted text of `date`.
    virtual std::u16string value(const ContentEnvironment& environment) const = 0;
    // The moment to show.
    virtual Date date(const ContentEnvironment& environment) const = 0;

    Text format;  // "short", "medium", "long", "full", or a Unicode date pattern
    Text locale;  // a locale identifier; absent: the environment's
};

class SnippetDateVariable final : public SnippetDateTimeVariable {
  public:
    enum class ValueType : std::int32_t { Offset = 0, NextWeekday = 1, PreviousWeekday = 2 };

    SnippetDateVariable() = default;
    explicit SnippetDateVariable(const VariableParams& params);
    std::u16string toString() const override;
    std::u16string value(const ContentEnvironment& environment) const override;
    Date date(const ContentEnvironment& environment) const override;
    bool valueIsToday() const { return valueType == ValueType::Offset; }

    ValueType valueType = ValueType::Offset;  // any value but the first two counts as the previous weekday
    std::int64_t year = 0;
    std::int64_t month = 0;
    std::int64_t day = 0;
    std::int64_t weekday = 0;  // 0 Sunday to 6 Saturday
};

class SnippetTimeVariable final : public SnippetDateTimeVariable {
  public:
    SnippetTimeVariable() = default;
    explicit SnippetTimeVariable(const VariableParams& params);
    std::u16string toString() const override;
    std::u16string value(const ContentEnvironment& environment) const override;
    Date date(const ContentEnvironment& environment) const override;

    std::int64_t hour = 0;
    std::int64_t minute = 0;
    std::int64_t second = 0;
};

}  // namespace plume
