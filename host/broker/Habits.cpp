#include "broker/Habits.h"

#include "broker/Tables.h"

#include <algorithm>
#include <array>

namespace cimhost {

namespace {

std::array<const Habits*, 2> allHabits()
{
    return {&sfcbHabits(), &pegasusHabits()};
}

/// Calls each function of one kind.
template <class Way, class... Arguments>
void forEachOfKind(const Habits* habits, Arguments&... arguments)
{
    if (habits == nullptr)
        return;
    for (const Habit& habit : habits->rows)
        if (const Way* way = std::get_if<Way>(&habit.way))
            (*way)(arguments...);
}

} // namespace

const Habits* findHabits(std::string_view name)
{
    const auto all = allHabits();
    const auto* found =
        std::find_if(all.begin(), all.end(), [&](const Habits* habits) { return habits->name == name; });
    return found == all.end() ? nullptr : *found;
}

std::vector<std::string> namesOfHabits()
{
    std::vector<std::string> names;
    for (const Habits* habits : allHabits())
        names.emplace_back(habits->name);
    return names;
}

void takeOn(const Habits* habits, FunctionTables& tables, CMPIBroker& broker)
{
    forEachOfKind<HabitInTables>(habits, tables, broker);
}

void shape(const Habits* habits, OperationRequest& question, const RegisteredClass& served)
{
    forEachOfKind<HabitInQuestion>(habits, question, served);
}

void shape(const Habits* habits, cim::Answer& answer, const OperationRequest& question)
{
    forEachOfKind<HabitInAnswer>(habits, answer, question);
}

const FunctionTables& plainServices()
{
    static const FunctionTables tables = servedTables();
    return tables;
}

void haveNoMemoryServices(FunctionTables& /*tables*/, CMPIBroker& broker)
{
    broker.mft = nullptr;
}

CMPIData withState(CMPIData data, unsigned int state)
{
    data.state = static_cast<CMPIValueState>(state);
    return data;
}

void writeCode(CMPIStatus* rc, CMPIrc code)
{
    if (rc != nullptr)
        *rc = {code, nullptr};
}

} // namespace cimhost
