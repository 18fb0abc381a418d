#include "content/PlaceholderBody.h"

#include <algorithm>
#include <limits>

#include "Foundation/Strings.h"

namespace plume {
namespace {

// Reads the parameters of a body. A dedicated reader, because CSVParser costs more than a placeholder may: what it
// accepts and where it stops is the same.
class ParameterReader {
  public:
    explicit ParameterReader(std::u16string_view body) : body_(body) {}

    VariableParams read() {
        VariableParams params;
        while (readParameter(params) && skipSpaces()) {
        }
        return params;
    }

  private:
    bool atEnd() const { return next_ == body_.size(); }
    bool at(char16_t unit) const { return !atEnd() && body_[next_] == unit; }

    bool skipSpaces() {
        const std::size_t start = next_;
        while (at(u' ')) ++next_;
        return next_ > start;
    }

    bool skipColon() {
        if (!at(u':')) return false;
        ++next_;
        return true;
    }

    // False when no parameter starts here.
    bool readParameter(VariableParams& params) {
        if (atEnd() || at(u' ')) return false;
        std::u16string name;
        std::u16string value;
        if (!readField(name)) return false;
        if (skipColon() && readField(value)) {
            std::u16string surplus;
            while (skipColon() && readField(surplus)) {
            }
        }
        params.insert_or_assign(std::move(name), std::move(value));
        return true;
    }

    // False, with an empty field, when a closing quote is missing.
    bool readField(std::u16string& field) {
        field.clear();
        if (at(u'"')) return readQuotedField(field);
        const std::size_t end = std::min(body_.find_first_of(u" \":", next_), body_.size());
        field = body_.substr(next_, end - next_);
        next_ = end;
        return true;
    }

    bool readQuotedField(std::u16string& field) {
        ++next_;
        while (true) {
            const std::size_t quote = body_.find(u'"', next_);
            if (quote == std::u16string_view::npos) {
                next_ = body_.size();
                field.clear();
                return false;
            }
            field += body_.substr(next_, quote - next_);
            next_ = quote + 1;
            if (!at(u'"')) return true;
            field += u'"';
            ++next_;
        }
    }

    std::u16string_view body_;
    std::size_t next_ = 0;
};

}  // namespace

VariableParams parseParams(std::u16string_view body) {
    return ParameterReader(body).read();
}

std::optional<std::u16string> textParam(const VariableParams& params, std::u16string_view name) {
    const auto found = params.find(name);
    if (found == params.end()) return std::nullopt;
    return found->second;
}

std::int64_t integerParam(const VariableParams& params, std::u16string_view name) {
    const auto found = params.find(name);
    return found == params.end() ? 0 : integerValue(found->second);
}

std::int32_t shortIntegerParam(const VariableParams& params, std::u16string_view name) {
    using Limits = std::numeric_limits<std::int32_t>;
    return static_cast<std::int32_t>(
        std::clamp<std::int64_t>(integerParam(params, name), Limits::min(), Limits::max()));
}

std::u16string escapeParam(std::u16string_view value) {
    if (value.find_first_of(u": \"") == std::u16string_view::npos) return std::u16string(value);
    std::u16string escaped(1, u'"');
    for (const char16_t unit : value) {
        if (unit == u'"') escaped += u'"';
        escaped += unit;
    }
    escaped += u'"';
    return escaped;
}

void BodyWriter::part(std::u16string_view text) {
    if (text.empty()) return;
    if (!body_.empty()) body_ += u' ';
    body_ += text;
}

void BodyWriter::param(std::u16string_view name, std::u16string_view value) {
    part(name);
    body_ += u':';
    body_ += escapeParam(value);
}

void BodyWriter::param(std::u16string_view name, std::int64_t value) {
    param(name, fromUtf8(std::to_string(value)));
}

void BodyWriter::unsignedParam(std::u16string_view name, std::uint64_t value) {
    param(name, fromUtf8(std::to_string(value)));
}

void BodyWriter::paramUnlessZero(std::u16string_view name, std::int64_t value) {
    if (value != 0) param(name, value);
}

void BodyWriter::paramIfSet(std::u16string_view name, const std::optional<std::u16string>& value) {
    if (value) param(name, *value);
}

}  // namespace plume
