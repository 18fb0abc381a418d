// The rows of one group in the icon's menu, or of a range of them where the group has many.
//
// Owned by the menu that it is opened from; belongs to the main thread. Filled when it is about to be shown: a group of
// thousands costs no more than the forty rows that are looked at.
#pragma once

#include <QMenu>
#include <functional>
#include <memory>
#include <vector>

#include "app/status/MenuTexts.h"
#include "library/SnippetGroup.h"

namespace plume {

class SnippetRowsMenu final : public QMenu {
    Q_OBJECT
  public:
    static constexpr std::size_t MostRows = 40;

    // Of the items [first, end) of the group, as far as it has them then. `end` may lie behind its last item.
    struct Range {
        std::weak_ptr<const SnippetGroup> group;
        std::size_t first = 0;
        std::size_t end = NotFound;
    };
    // Called when the user has chosen a row, while the menu may still be seen.
    using Choose = std::function<void(const std::weak_ptr<Snippet>&)>;

    SnippetRowsMenu(Range range, MenuHome home, Choose choose, QWidget* parent);

    const Range& range() const { return range_; }
    // A new opening: the rows are looked up again when they are about to be shown. Until then they stay, for a panel
    // may show what it was sent.
    void expire();

  private:
    struct Row {
        QString text;
        std::weak_ptr<Snippet> snippet = {};  // or
        Range range = {};

        bool isSameAs(const Row& other) const;
    };

    void fill();
    std::vector<Row> rowsOfNow() const;
    void addRow(const Row& row);

    const Range range_;
    const MenuHome home_;
    const Choose choose_;
    bool isFresh_ = false;
    std::vector<Row> rows_;
};

}  // namespace plume
