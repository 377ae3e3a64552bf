// The undo history of the open setup. An edit that stays within the node of the form on
// show is kept as that node's text before and after; an edit that changes the shape of the
// tree (counts, rows) or comes from elsewhere keeps the whole text after it, and the state
// before it as the last whole text plus the node edits made since. The history is bounded
// by memory, oldest steps dropped first.
#pragma once

#include <QString>

#include <cstddef>
#include <functional>
#include <memory>
#include <string>
#include <vector>

class CSetupDocument;
class CZoSEKivBase;
class QUndoStack;

class CSetupHistory {
public:
    // What the history may hold besides one text of the setup.
    static constexpr size_t kBudgetBytes = size_t(64) << 20;

    // One node's text at its place in the tree.
    struct NodeText {
        std::vector<int> place;
        std::string text;
    };
    struct Change;

    // restore runs a change of the document; structural says whether nodes may have been
    // remade (the window then rebuilds its tree rather than refreshing it).
    using Restorer = std::function<void(const std::function<void()>& change, bool structural)>;
    CSetupHistory(QUndoStack* stack, Restorer restore);
    ~CSetupHistory();

    // An empty history for doc, whose state is the clean one.
    void Start(CSetupDocument* doc);
    // The node whose form is on show: its edits are kept as its own text.
    void Watch(CZoSEKivBase* node);
    // Records what changed since the last record as one step named by name(), asked only
    // when there is a step; edited is the node of the form that made the change (null when
    // unknown), hint the form's update hint.
    void Record(CZoSEKivBase* edited, int hint, const std::function<QString()>& name);
    // What the steps hold, in bytes, and at most.
    size_t MemoryBytes() const;
    size_t Budget() const { return m_budget; }
    void SetBudget(size_t bytes) { m_budget = bytes; }

    // Undo and redo of one step (the stack's commands call these).
    void Apply(const Change& change, bool forward);

private:
    bool WatchIsCurrent();
    void PushStep(std::shared_ptr<const Change> change, const QString& name);
    void DropOldest();
    void CollapseIfLarge();

    QUndoStack* m_stack;
    Restorer m_restore;
    size_t m_budget = kBudgetBytes;
    CSetupDocument* m_doc = nullptr;
    // The last whole text and the node texts restored or recorded since: together the
    // document's present state.
    std::shared_ptr<const std::string> m_base;
    std::vector<std::shared_ptr<const NodeText>> m_sinceBase;
    size_t m_sinceBaseBytes = 0;
    CZoSEKivBase* m_watched = nullptr;
    std::shared_ptr<const NodeText> m_watchedText;  // null when not known for this state
    unsigned long m_shape = 0;
};
