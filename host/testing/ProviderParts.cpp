#include "testing/ProviderParts.h"

namespace sample {

const CMPIBroker* broker = nullptr;

namespace {

struct NotSupported
{
    static CMPIStatus cleanup(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/, CMPIBoolean terminating)
    {
        say(std::string("cleanup ") + (terminating != 0 ? "terminating" : "going on"));
        return ok;
    }
    static CMPIStatus onClass(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/,
                              const CMPIResult* /*result*/, const CMPIObjectPath* /*path*/)
    {
        return {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
    }
    static CMPIStatus withProperties(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/,
                                     const CMPIResult* /*result*/, const CMPIObjectPath* /*path*/,
                                     const char** /*properties*/)
    {
        return {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
    }
    static CMPIStatus create(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/,
                             const CMPIResult* /*result*/, const CMPIObjectPath* /*path*/,
                             const CMPIInstance* /*instance*/)
    {
        return {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
    }
    static CMPIStatus modify(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/,
                             const CMPIResult* /*result*/, const CMPIObjectPath* /*path*/,
                             const CMPIInstance* /*instance*/, const char** /*properties*/)
    {
        return {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
    }
    static CMPIStatus query(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/,
                            const CMPIResult* /*result*/, const CMPIObjectPath* /*path*/,
                            const char* /*query*/, const char* /*language*/)
    {
        return {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
    }
};

} // namespace

CMPIStatus failure(CMPIrc code, const char* message)
{
    return {code, broker->eft->newString(broker, message, nullptr)};
}

const CMPIValue* chars(const char* text)
{
    return reinterpret_cast<const CMPIValue*>(text);
}

std::string textOf(const CMPIString* string)
{
    const char* const text = string == nullptr ? nullptr : string->ft->getCharPtr(string, nullptr);
    return text == nullptr ? "" : text;
}

CMPIObjectPath* newPath(const CMPIObjectPath* request, const char* className)
{
    const std::string nameSpace = textOf(request->ft->getNameSpace(request, nullptr));
    return broker->eft->newObjectPath(broker, nameSpace.c_str(), className, nullptr);
}

void say(const std::string& text, CMPILevel level)
{
    broker->eft->trace(broker, level, "Sample", text.c_str(), nullptr);
}

CMPIInstanceMIFT notSupported(const char* name)
{
    return {200,
            200,
            name,
            NotSupported::cleanup,
            NotSupported::onClass,
            NotSupported::withProperties,
            NotSupported::withProperties,
            NotSupported::create,
            NotSupported::modify,
            NotSupported::onClass,
            NotSupported::query};
}

} // namespace sample
