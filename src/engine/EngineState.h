// What those who send and correct see of the engine: the buffer, the library and the record for undo.
//
// Belongs to the thread that delivers the key events; whoever finishes on another thread hands over to that one first.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "engine/UndoInformation.h"
#include "library/SnippetGroup.h"

namespace plume {

class EngineState {
  public:
    using Groups = std::vector<std::shared_ptr<SnippetGroup>>;

    // Empties the buffer and closes the lists that are open.
    virtual void clear() = 0;
    // What was typed since the last reset.
    virtual const std::u16string& letters() const = 0;
    virtual void setLetters(std::u16string_view letters) = 0;

    // The library, in user order.
    virtual const Groups& snippetGroups() const = 0;
    // How content is adapted to the case in which its abbreviation was typed.
    virtual std::int64_t snippetAdaptToAbbreviationCaseOption() const = 0;

    // Kept until the next key.
    virtual const std::optional<UndoInformation>& undoInfo() const = 0;
    virtual void setUndoInfo(std::optional<UndoInformation> undoInfo) = 0;

  protected:
    ~EngineState() = default;
};

}  // namespace plume
