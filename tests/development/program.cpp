// Calls each of the installed support libraries once.

#include <MVLog/MVLogger.h>
#include <MVLog/MVMessageBuffer.h>
#include <Tavro/Common.h>
#include <Tavro/Instrumentation.h>
#include <Tavro/Locale.h>
#include <Tavro/NodeLexicon.h>

#include <iostream>

int main()
{
    Tavro::Instrumentation inventory;
    inventory.selectNode(static_cast<Tavro::NodeLexicon::NodeType>(36));
    MVLog::MVMessageBuffer message;
    message << Tavro::stripSpaces(" four libraries ").c_str() << " in ";
    std::cout << message.str() << Tavro::make_string(L"all: ") << (inventory ? "a node" : "no node") << '\n';
}
