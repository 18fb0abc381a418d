#include "app/editor/LibraryUndo.h"

#include <QCoreApplication>
#include <array>
#include <utility>

namespace plume {

namespace {

// Typing that pauses so long goes on as another edit.
constexpr std::chrono::seconds TypingPause{2};
constexpr int TypingId = 1;

class ChangeCommand final : public QUndoCommand {
  public:
    using Applied = std::function<void(const LibraryChange& change, bool isUndo)>;

    ChangeCommand(LibraryChange change, bool isTyping, Applied apply)
        : QUndoCommand(nameOf(change)), change_(std::move(change)), isTyping_(isTyping), apply_(std::move(apply)) {}

    void undo() override { apply_(change_, true); }
    void redo() override {
        // The first time it is done already.
        if (std::exchange(isNew_, false)) return;
        apply_(change_, false);
    }
    int id() const override { return TypingId; }
    bool mergeWith(const QUndoCommand* other) override {
        const auto* later = static_cast<const ChangeCommand*>(other);
        return later->isTyping_ && change_.absorb(later->change_);
    }

  private:
    LibraryChange change_;
    const bool isTyping_;  // it may be the rest of what the one before began
    const Applied apply_;
    bool isNew_ = true;
};

QString counted(const char* text, std::size_t count) {
    return QCoreApplication::translate("LibraryUndo", text, nullptr, static_cast<int>(count));
}

}  // namespace

LibraryUndo::LibraryUndo(LibraryEditor& editor) : editor_(editor) {}

void LibraryUndo::push(const LibraryChange& change) {
    const auto now = std::chrono::steady_clock::now();
    const bool isTyping = now - lastChange_ < TypingPause;
    lastChange_ = now;
    stack_.push(new ChangeCommand(change, isTyping, [this](const LibraryChange& applied, bool isUndo) {
        endTyping();
        const bool isDone = isUndo ? editor_.undo(applied) : editor_.redo(applied);
        isDone ? Q_EMIT changed(applied) : Q_EMIT refused();
    }));
}

QString nameOf(const LibraryChange& change) {
    // In the order of EditKind.
    static constexpr std::array Names{
        QT_TRANSLATE_NOOP("LibraryUndo", "Change of Abbreviation"),
        QT_TRANSLATE_NOOP("LibraryUndo", "Change of Label"),
        QT_TRANSLATE_NOOP("LibraryUndo", "Change of Note"),
        QT_TRANSLATE_NOOP("LibraryUndo", "Change of Case"),
        QT_TRANSLATE_NOOP("LibraryUndo", "Change of Kind"),
        QT_TRANSLATE_NOOP("LibraryUndo", "Change of Content"),
        QT_TRANSLATE_NOOP("LibraryUndo", "Change of Group Name"),
        QT_TRANSLATE_NOOP("LibraryUndo", "Change of Group Settings"),
        QT_TRANSLATE_NOOP("LibraryUndo", "New Snippets (%n)"),
        QT_TRANSLATE_NOOP("LibraryUndo", "New Groups (%n)"),
        QT_TRANSLATE_NOOP("LibraryUndo", "Deletion (%n)"),
        QT_TRANSLATE_NOOP("LibraryUndo", "Move (%n)"),
        QT_TRANSLATE_NOOP("LibraryUndo", "Copy (%n)"),
        QT_TRANSLATE_NOOP("LibraryUndo", "Duplication (%n)"),
        QT_TRANSLATE_NOOP("LibraryUndo", "Deletion of Duplicates (%n)"),
        QT_TRANSLATE_NOOP("LibraryUndo", "Sorting"),
        QT_TRANSLATE_NOOP("LibraryUndo", "Sorting of Groups"),
        QT_TRANSLATE_NOOP("LibraryUndo", "Reset of Case (%n)"),
        QT_TRANSLATE_NOOP("LibraryUndo", "New Group"),
        QT_TRANSLATE_NOOP("LibraryUndo", "Import"),
        QT_TRANSLATE_NOOP("LibraryUndo", "Kept Edit"),
    };
    return counted(Names.at(static_cast<std::size_t>(change.kind)), change.count);
}

}  // namespace plume
