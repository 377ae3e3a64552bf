#include "SetupHistory.h"

#include "host/SetupDocument.h"
#include "widgets/ZoSEDlgBase.h"

#include <QSignalBlocker>
#include <QUndoStack>

#include <unordered_set>

struct CSetupHistory::Change {
    // An edit within a node: its text before and after.
    std::shared_ptr<const NodeText> before;
    std::shared_ptr<const NodeText> after;
    // Any other edit: the whole text after it; before it, the whole text base with the node
    // texts of replay read over it in order.
    std::shared_ptr<const std::string> whole;
    std::shared_ptr<const std::string> base;
    std::vector<std::shared_ptr<const NodeText>> replay;
};

namespace {

// One step on the stack. The first redo is the change itself, already made.
class CSetupStep : public QUndoCommand {
public:
    CSetupStep(CSetupHistory* history, std::shared_ptr<const CSetupHistory::Change> change, const QString& name)
        : QUndoCommand(name), m_history(history), m_change(std::move(change)) {}
    void undo() override { m_history->Apply(*m_change, false); }
    void redo() override {
        if (m_done)
            m_history->Apply(*m_change, true);
        m_done = true;
    }
    const std::shared_ptr<const CSetupHistory::Change>& Data() const { return m_change; }

private:
    CSetupHistory* m_history;
    std::shared_ptr<const CSetupHistory::Change> m_change;
    bool m_done = false;
};

// Adds what the change holds that was not counted yet.
size_t CountNew(const CSetupHistory::Change& c, std::unordered_set<const void*>& seen) {
    size_t bytes = 0;
    auto text = [&](const std::shared_ptr<const std::string>& s) {
        if (s && seen.insert(s.get()).second)
            bytes += s->capacity();
    };
    auto node = [&](const std::shared_ptr<const CSetupHistory::NodeText>& n) {
        if (n && seen.insert(n.get()).second)
            bytes += n->text.capacity() + n->place.capacity() * sizeof(int);
    };
    node(c.before);
    node(c.after);
    text(c.whole);
    text(c.base);
    for (const auto& r : c.replay)
        node(r);
    return bytes + sizeof(CSetupHistory::Change) + c.replay.capacity() * sizeof(c.replay[0]);
}

// Kept for long: no room beyond the text.
std::shared_ptr<const std::string> WholeText(CSetupDocument* doc) {
    std::string text = doc->ToText();
    text.shrink_to_fit();
    return std::make_shared<const std::string>(std::move(text));
}

bool Within(const CZoSEKivBase* node, const CZoSEKivBase* ancestor) {
    for (; node; node = node->GetParent())
        if (node == ancestor)
            return true;
    return false;
}

}  // namespace

CSetupHistory::CSetupHistory(QUndoStack* stack, Restorer restore) : m_stack(stack), m_restore(std::move(restore)) {}

CSetupHistory::~CSetupHistory() = default;

void CSetupHistory::Start(CSetupDocument* doc) {
    m_stack->clear();
    m_doc = doc;
    m_base = WholeText(doc);
    m_sinceBase.clear();
    m_sinceBaseBytes = 0;
    m_watched = nullptr;
    m_watchedText.reset();
    m_shape = doc->ShapeChanges();
    m_stack->setClean();
}

void CSetupHistory::Watch(CZoSEKivBase* node) {
    if (node == m_watched && m_watchedText)
        return;
    m_watched = node;
    m_watchedText.reset();
    if (!node || !m_doc || node == m_doc || m_doc->ShapeChanges() != m_shape)
        return;
    std::vector<int> place = m_doc->PlaceOf(node);
    if (place.empty())
        return;
    m_watchedText = std::make_shared<const NodeText>(NodeText{std::move(place), CSetupDocument::NodeText(node)});
}

bool CSetupHistory::WatchIsCurrent() { return m_watched && m_watchedText && m_doc->ShapeChanges() == m_shape; }

void CSetupHistory::Record(CZoSEKivBase* edited, int hint, const std::function<QString()>& name) {
    if (!m_doc)
        return;
    constexpr int kShapeHints = kHintItemsAdded | kHintItemsDeleted | kHintItemsReordered | kHintTitleChanged;
    if (edited && !(hint & kShapeHints) && WatchIsCurrent() && Within(edited, m_watched)) {
        std::string text = CSetupDocument::NodeText(m_watched);
        text.shrink_to_fit();
        auto after = std::make_shared<const NodeText>(NodeText{m_watchedText->place, std::move(text)});
        if (after->text == m_watchedText->text)
            return;  // nothing that the file holds changed
        auto change = std::make_shared<Change>();
        change->before = m_watchedText;
        change->after = after;
        m_watchedText = after;
        m_sinceBase.push_back(after);
        m_sinceBaseBytes += after->text.size();
        PushStep(std::move(change), name());
        CollapseIfLarge();
        return;
    }
    auto whole = WholeText(m_doc);
    const bool sameShape = m_doc->ShapeChanges() == m_shape;
    if (m_sinceBase.empty() && *whole == *m_base) {
        if (!sameShape) {
            m_shape = m_doc->ShapeChanges();
            m_watched = nullptr;
            m_watchedText.reset();
        }
        return;
    }
    auto change = std::make_shared<Change>();
    change->whole = whole;
    change->base = m_base;
    change->replay = std::move(m_sinceBase);
    m_base = whole;
    m_sinceBase.clear();
    m_sinceBaseBytes = 0;
    m_shape = m_doc->ShapeChanges();
    // The form on show keeps its node unless the tree changed its shape.
    CZoSEKivBase* watched = sameShape ? m_watched : nullptr;
    m_watched = nullptr;
    m_watchedText.reset();
    PushStep(std::move(change), name());
    Watch(watched);
}

void CSetupHistory::Apply(const Change& change, bool forward) {
    // The window shows the form again, which watches its node in the state restored.
    m_watched = nullptr;
    m_watchedText.reset();
    if (!change.whole) {
        const std::shared_ptr<const NodeText>& t = forward ? change.after : change.before;
        m_restore(
            [&] {
                if (CZoSEKivBase* node = m_doc->NodeAt(t->place))
                    CSetupDocument::RestoreNode(node, t->text);
            },
            false);
        m_sinceBase.push_back(t);
        m_sinceBaseBytes += t->text.size();
    } else if (forward) {
        m_restore([&] { m_doc->Restore(*change.whole); }, true);
        m_base = change.whole;
        m_sinceBase.clear();
        m_sinceBaseBytes = 0;
    } else {
        m_restore(
            [&] {
                m_doc->Restore(*change.base);
                for (const auto& t : change.replay)
                    if (CZoSEKivBase* node = m_doc->NodeAt(t->place))
                        CSetupDocument::RestoreNode(node, t->text);
            },
            true);
        m_base = change.base;
        m_sinceBase = change.replay;
        m_sinceBaseBytes = 0;
        for (const auto& t : m_sinceBase)
            m_sinceBaseBytes += t->text.size();
    }
    m_shape = m_doc->ShapeChanges();
    CollapseIfLarge();
}

void CSetupHistory::CollapseIfLarge() {
    // Node texts since the last whole text are kept for the next edit of the tree's shape;
    // past an eighth of the budget a new whole text is cheaper to keep.
    if (m_sinceBaseBytes <= m_budget / 8)
        return;
    m_base = WholeText(m_doc);
    m_sinceBase.clear();
    m_sinceBaseBytes = 0;
}

void CSetupHistory::PushStep(std::shared_ptr<const Change> change, const QString& name) {
    m_stack->push(new CSetupStep(this, std::move(change), name));
    DropOldest();
}

size_t CSetupHistory::MemoryBytes() const {
    std::unordered_set<const void*> seen{m_base.get()};
    size_t bytes = 0;
    for (int i = 0; i < m_stack->count(); ++i)
        if (const auto* step = dynamic_cast<const CSetupStep*>(m_stack->command(i)))
            bytes += CountNew(*step->Data(), seen);
    return bytes;
}

void CSetupHistory::DropOldest() {
    // Newest first, as many steps as the budget holds; the newest stays whatever it holds.
    const int count = m_stack->count();
    std::unordered_set<const void*> seen{m_base.get()};
    size_t bytes = 0;
    int keepFrom = count;
    while (keepFrom > 0) {
        const auto* step = dynamic_cast<const CSetupStep*>(m_stack->command(keepFrom - 1));
        bytes += step ? CountNew(*step->Data(), seen) : 0;
        if (bytes > m_budget && keepFrom < count)
            break;
        --keepFrom;
    }
    if (keepFrom == 0)
        return;
    // The stack drops only by count, so it is built again from the steps kept; the last
    // push left nothing to redo. The window sees no change of the clean state.
    struct Kept {
        std::shared_ptr<const Change> change;
        QString name;
    };
    std::vector<Kept> kept;
    for (int i = keepFrom; i < count; ++i) {
        const auto* step = static_cast<const CSetupStep*>(m_stack->command(i));
        kept.push_back({step->Data(), step->text()});
    }
    const int clean = m_stack->cleanIndex();
    const QSignalBlocker block(m_stack);
    m_stack->clear();
    for (size_t i = 0; i < kept.size(); ++i) {
        if (clean == keepFrom + static_cast<int>(i))
            m_stack->setClean();
        m_stack->push(new CSetupStep(this, kept[i].change, kept[i].name));
    }
    if (clean == count)
        m_stack->setClean();
    else if (clean < keepFrom)
        m_stack->resetClean();
}
