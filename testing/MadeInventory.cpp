#include "testing/MadeInventory.h"

#include <Tavro/Instrumentation.h>

#include <atomic>
#include <memory>
#include <mutex>
#include <utility>

namespace MadeInventory {

namespace {

struct State
{
    std::shared_ptr<const std::vector<Node>> nodes = std::make_shared<const std::vector<Node>>();
    std::optional<std::size_t> throwingPosition;
    std::exception_ptr exception;
};

std::mutex mutex;
State state;
std::atomic<int> cursors{0};
std::atomic<int> selected{0};
std::atomic<unsigned int> lastValue{0};

} // namespace

void set(std::vector<Node> nodes)
{
    const std::lock_guard lock(mutex);
    state = State{std::make_shared<const std::vector<Node>>(std::move(nodes)), std::nullopt, nullptr};
}

void throwAt(std::optional<std::size_t> position, std::exception_ptr exception)
{
    const std::lock_guard lock(mutex);
    state.throwingPosition = position;
    state.exception = std::move(exception);
}

int openCursors()
{
    return cursors;
}

int selections()
{
    return selected;
}

unsigned int valueBeforeGetProperty()
{
    return lastValue;
}

} // namespace MadeInventory

namespace Tavro {

struct Instrumentation::Implementation
{
    MadeInventory::State inventory;
    std::size_t position = 0;
    std::optional<unsigned int> kind;

    void skipOthers()
    {
        while (position < inventory.nodes->size() && (*inventory.nodes)[position].kind != *kind)
            ++position;
    }
    [[nodiscard]] bool onNode() const { return kind && position < inventory.nodes->size(); }
    [[nodiscard]] const MadeInventory::Node& node() const { return inventory.nodes->at(position); }
};

Instrumentation::Instrumentation() : implementation_(std::make_unique<Implementation>())
{
    const std::lock_guard lock(MadeInventory::mutex);
    implementation_->inventory = MadeInventory::state;
    ++MadeInventory::cursors;
}

Instrumentation::~Instrumentation()
{
    --MadeInventory::cursors;
}

void Instrumentation::selectNode(NodeLexicon::NodeType kind)
{
    ++MadeInventory::selected;
    implementation_->kind = kind;
    implementation_->position = 0;
    implementation_->skipOthers();
}

Instrumentation::operator bool() const
{
    return implementation_->onNode();
}

Instrumentation& Instrumentation::operator++()
{
    ++implementation_->position;
    implementation_->skipOthers();
    return *this;
}

std::string Instrumentation::getPathToNode() const
{
    return implementation_->node().path;
}

// Different from the path, so that a test sees which of the two is used.
std::string Instrumentation::convertPathToString(const std::string& path) const
{
    return "/" + path;
}

std::string Instrumentation::getNodeDescription() const
{
    const MadeInventory::State& inventory = implementation_->inventory;
    if (inventory.throwingPosition == implementation_->position)
        std::rethrow_exception(inventory.exception);
    return implementation_->node().description;
}

unsigned int Instrumentation::getNodeStatus() const
{
    return implementation_->node().status;
}

bool Instrumentation::getProperty(NodeLexicon::Properties property, unsigned int& value) const
{
    MadeInventory::lastValue = value;
    const auto& alarmState = implementation_->node().alarmState;
    if (property != static_cast<NodeLexicon::Properties>(1) || !alarmState)
        return false;
    value = *alarmState;
    return true;
}

} // namespace Tavro
