#include "broker/Scope.h"

#include "broker/Call.h"

namespace cimhost {

namespace {

thread_local Scope* current = nullptr;

} // namespace

Scope::Scope(Core& core)
    : core_(core),
      outer_(current),
      depth_(current == nullptr ? 0 : current->depth_ + 1),
      store_(core)
{
    current = this;
}

Scope::~Scope()
{
    current = outer_;
}

std::shared_ptr<const NameSet> Scope::filterOf(const char* const* names)
{
    if (!lastFilter_ || !lastFilter_->isOf(names))
        lastFilter_ = std::make_shared<const NameSet>(takeNames(names));
    return lastFilter_;
}

Scope* Scope::outer() const
{
    return firstOf(core_, outer_);
}

Scope* Scope::innermost(const Core& core)
{
    return firstOf(core, current);
}

Scope* Scope::firstOf(const Core& core, Scope* scope)
{
    while (scope != nullptr && &scope->core_ != &core)
        scope = scope->outer_;
    return scope;
}

Core* Scope::currentCore()
{
    return current == nullptr ? nullptr : &current->core_;
}

std::shared_ptr<const NameSet> filterOf(Core& core, const char* const* names)
{
    Scope* const scope = Scope::innermost(core);
    return scope != nullptr ? scope->filterOf(names) : std::make_shared<const NameSet>(takeNames(names));
}

OutsideScopes::OutsideScopes() : suspended_(current)
{
    current = nullptr;
}

OutsideScopes::~OutsideScopes()
{
    current = suspended_;
}

} // namespace cimhost
