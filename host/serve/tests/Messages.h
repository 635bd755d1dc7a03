/// \file
/// Request messages for the tests.
#ifndef CIMHOST_SERVE_TESTS_MESSAGES_H
#define CIMHOST_SERVE_TESTS_MESSAGES_H

#include <string>

namespace cimhost::serve {

inline std::string messageWith(const std::string& content)
{
    return R"(<?xml version="1.0" encoding="utf-8"?><CIM CIMVERSION="2.0" DTDVERSION="2.0">)"
           R"(<MESSAGE ID="42" PROTOCOLVERSION="1.0">)" +
           content + "</MESSAGE></CIM>";
}

/// An intrinsic operation in root/cimv2.
inline std::string callOf(const std::string& method, const std::string& parameters)
{
    return messageWith("<SIMPLEREQ><IMETHODCALL NAME=\"" + method +
                       R"("><LOCALNAMESPACEPATH><NAMESPACE NAME="root"/><NAMESPACE NAME="cimv2"/>)"
                       "</LOCALNAMESPACEPATH>" +
                       parameters + "</IMETHODCALL></SIMPLEREQ>");
}

inline std::string parameter(const std::string& name, const std::string& value)
{
    return "<IPARAMVALUE NAME=\"" + name + "\">" + value + "</IPARAMVALUE>";
}

inline std::string className(const std::string& name = "CIM_A")
{
    return "<CLASSNAME NAME=\"" + name + "\"/>";
}

inline std::string text(const std::string& content)
{
    return "<VALUE>" + content + "</VALUE>";
}

/// CIM_A.Name="x"
inline std::string instanceName()
{
    return R"(<INSTANCENAME CLASSNAME="CIM_A"><KEYBINDING NAME="Name"><KEYVALUE>x</KEYVALUE></KEYBINDING></INSTANCENAME>)";
}

} // namespace cimhost::serve

#endif
