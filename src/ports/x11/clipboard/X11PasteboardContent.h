// What Plume offers on a selection: content that was written, or an owner's promise of it.
//
// Belongs to the tap thread.
#pragma once

#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "platform/Pasteboard.h"
#include "ports/x11/XcbConnection.h"
#include "ports/x11/clipboard/X11SelectionOwner.h"

namespace plume {

// Type and format that other programs gave their targets' values, by the target's name.
using X11ValueForms = std::map<std::string, std::pair<xcb_atom_t, std::uint8_t>, std::less<>>;

class X11PasteboardContent final : public X11SelectionContent {
  public:
    // Calls the owner with `pasteboard`, which hands on to set() what the owner provides. `forms` are for content that
    // is given back. All outlive the content.
    X11PasteboardContent(XcbConnection& connection, Pasteboard& pasteboard, std::vector<std::string> types,
                         PasteboardOwner* owner, const X11ValueForms& forms);

    const std::vector<std::string>& types() const { return types_; }
    // Promised data is asked for now, and once.
    std::optional<std::string> data(std::string_view type);
    void set(std::string bytes, std::string_view type);
    // Promised for a paste, as nothing that comes from another program is: such content has the program's names, too.
    bool isExpansion() const { return isExpansion_; }
    // Whether it hints, to those who ask, that clipboard managers are to keep nothing. An expansion does, and says so
    // in its targets.
    void setHints(bool hints) { hints_ = hints; }
    // Whether that is what the target of this name is for.
    static bool isHint(std::string_view target);
    // Asks for everything that is still only promised.
    void redeemAll();

    std::vector<xcb_atom_t> targets() override;
    std::optional<X11SelectionValue> value(xcb_atom_t target) override;
    void wasTaken(xcb_atom_t target) override;

  private:
    using Bytes = std::shared_ptr<const std::string>;

    std::vector<std::string> targetNames() const;
    Bytes redeemed(std::string_view type);
    bool declares(std::string_view type) const;
    std::string_view typeBehind(std::string_view target) const;
    Bytes bytesFor(std::string_view target);

    XcbConnection& connection_;
    Pasteboard& pasteboard_;
    const std::vector<std::string> types_;
    PasteboardOwner* const owner_;
    const X11ValueForms& forms_;
    const bool isExpansion_;
    bool hints_;
    std::map<std::string, Bytes, std::less<>> data_;
};

}  // namespace plume
