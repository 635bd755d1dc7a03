/// \file
/// A library that no loader can complete.

extern "C" int cimhostTestNobodyDefinesThis();
extern "C" int Unresolved_Create_InstanceMI();

extern "C" int Unresolved_Create_InstanceMI()
{
    return cimhostTestNobodyDefinesThis();
}
