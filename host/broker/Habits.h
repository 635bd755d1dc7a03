/// \file
/// What real brokers do otherwise than this one, as far as a provider or its clients can tell: for each of
/// them a table of observed facts. A new one is a row of its broker's table, and at most one function.
#ifndef CIMHOST_BROKER_HABITS_H
#define CIMHOST_BROKER_HABITS_H

#include "broker/FunctionTables.h"
#include "broker/OperationRequest.h"
#include "broker/Registration.h"
#include "cim/Model.h"

#include <string>
#include <string_view>
#include <variant>
#include <vector>

namespace cimhost {

/// Changes the tables that a provider calls through.
using HabitInTables = void (*)(FunctionTables& tables, CMPIBroker& broker);

/// Changes a question before a provider is asked.
/// \param served  the class that the provider is asked for
/// \throws RoutingError  the provider is not asked
using HabitInQuestion = void (*)(OperationRequest& question, const RegisteredClass& served);

/// Changes what came back.
/// \param question  as the provider was asked it
using HabitInAnswer = void (*)(cim::Answer& answer, const OperationRequest& question);

struct Habit
{
    const char* fact;
    const char* seenIn; ///< the version
    std::variant<HabitInTables, HabitInQuestion, HabitInAnswer> way;
};

struct Habits
{
    const char* name; ///< what a user calls the broker
    std::vector<Habit> rows;
};

/// Those of SFCB, "sfcb", and of OpenPegasus, "pegasus".
const Habits& sfcbHabits();
const Habits& pegasusHabits();

/// Those of the broker of that name; null: there is no table of it.
const Habits* findHabits(std::string_view name);

/// The names of all that have a table.
std::vector<std::string> namesOfHabits();

// Taking them on, row by row. A null pointer stands for none.

void takeOn(const Habits* habits, FunctionTables& tables, CMPIBroker& broker);
void shape(const Habits* habits, OperationRequest& question, const RegisteredClass& served);
void shape(const Habits* habits, cim::Answer& answer, const OperationRequest& question);

// What the tables' functions share.

/// The services as this broker serves them, for a function in the place of one.
const FunctionTables& plainServices();

/// A row's function.
void haveNoMemoryServices(FunctionTables& tables, CMPIBroker& broker);

/// Data with another state.
CMPIData withState(CMPIData data, unsigned int state);

/// Writes a code without a message.
/// \param rc  may be null
void writeCode(CMPIStatus* rc, CMPIrc code);

} // namespace cimhost

#endif
