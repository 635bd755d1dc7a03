#include "broker/Call.h"
#include "broker/Tables.h"

namespace cimhost {

namespace {

constexpr const char* theError = "the error";

/// Reads one plain member of an error.
template <class Member>
Member getMember(const char* service, const CMPIError* error, Member ErrorObject::*member, CMPIStatus* rc)
{
    return serve(service, rc, Member{},
                 [&](Call& call) { return call.use<ErrorObject>(error, theError).*member; });
}

CMPIString* getText(const char* service, const CMPIError* error, std::string ErrorObject::*member,
                    CMPIStatus* rc)
{
    return serve(service, rc, static_cast<CMPIString*>(nullptr),
                 [&](Call& call) { return call.makeString(call.use<ErrorObject>(error, theError).*member); });
}

using Texts = std::vector<cim::Value::Scalar>;

CMPIArray* getTexts(const char* service, const CMPIError* error, Texts ErrorObject::*member, CMPIStatus* rc)
{
    return serve(service, rc, static_cast<CMPIArray*>(nullptr), [&](Call& call) {
        const Texts& texts = call.use<ErrorObject>(error, theError).*member;
        return call.make<ArrayObject>(CMPIType{CMPI_string}, texts);
    });
}

template <class Member>
CMPIStatus setMember(const char* service, const CMPIError* error, Member ErrorObject::*member, Member value)
{
    return perform(service, [&](Call& call) { call.use<ErrorObject>(error, theError).*member = value; });
}

CMPIStatus setText(const char* service, const CMPIError* error, std::string ErrorObject::*member,
                   const char* text)
{
    return perform(service, [&](Call& call) {
        auto& content = call.use<ErrorObject>(error, theError);
        content.*member = call.text(text, "the text");
    });
}

CMPIStatus setTexts(const char* service, const CMPIError* error, Texts ErrorObject::*member,
                    const CMPIArray* texts)
{
    return perform(service, [&](Call& call) {
        auto& content = call.use<ErrorObject>(error, theError);
        const auto& array = call.use<ArrayObject>(texts, "the array");
        if (array.elementType != CMPI_string)
            call.refuse(CMPI_RC_ERR_TYPE_MISMATCH, "the array does not hold strings");
        content.*member = array.elements;
    });
}

CMPIStatus release(CMPIError* error)
{
    return releaseObject<ErrorObject>("CMPIErrorFT.release", error);
}

CMPIError* clone(const CMPIError* error, CMPIStatus* rc)
{
    return cloneObject<ErrorObject>("CMPIErrorFT.clone", error, rc);
}

CMPIErrorType getErrorType(const CMPIError* error, CMPIStatus* rc)
{
    return getMember("CMPIErrorFT.getErrorType", error, &ErrorObject::type, rc);
}

CMPIString* getOtherErrorType(const CMPIError* error, CMPIStatus* rc)
{
    return getText("CMPIErrorFT.getOtherErrorType", error, &ErrorObject::otherType, rc);
}

CMPIString* getOwningEntity(const CMPIError* error, CMPIStatus* rc)
{
    return getText("CMPIErrorFT.getOwningEntity", error, &ErrorObject::owningEntity, rc);
}

CMPIString* getMessageID(const CMPIError* error, CMPIStatus* rc)
{
    return getText("CMPIErrorFT.getMessageID", error, &ErrorObject::messageId, rc);
}

CMPIString* getMessage(const CMPIError* error, CMPIStatus* rc)
{
    return getText("CMPIErrorFT.getMessage", error, &ErrorObject::message, rc);
}

CMPIErrorSeverity getPerceivedSeverity(const CMPIError* error, CMPIStatus* rc)
{
    return getMember("CMPIErrorFT.getPerceivedSeverity", error, &ErrorObject::severity, rc);
}

CMPIErrorProbableCause getProbableCause(const CMPIError* error, CMPIStatus* rc)
{
    return getMember("CMPIErrorFT.getProbableCause", error, &ErrorObject::probableCause, rc);
}

CMPIString* getProbableCauseDescription(const CMPIError* error, CMPIStatus* rc)
{
    return getText("CMPIErrorFT.getProbableCauseDescription", error, &ErrorObject::probableCauseDescription,
                   rc);
}

CMPIArray* getRecommendedActions(const CMPIError* error, CMPIStatus* rc)
{
    return getTexts("CMPIErrorFT.getRecommendedActions", error, &ErrorObject::recommendedActions, rc);
}

CMPIString* getErrorSource(const CMPIError* error, CMPIStatus* rc)
{
    return getText("CMPIErrorFT.getErrorSource", error, &ErrorObject::source, rc);
}

CMPIErrorSrcFormat getErrorSourceFormat(const CMPIError* error, CMPIStatus* rc)
{
    return getMember("CMPIErrorFT.getErrorSourceFormat", error, &ErrorObject::sourceFormat, rc);
}

CMPIString* getOtherErrorSourceFormat(const CMPIError* error, CMPIStatus* rc)
{
    return getText("CMPIErrorFT.getOtherErrorSourceFormat", error, &ErrorObject::otherSourceFormat, rc);
}

CMPIrc getCIMStatusCode(const CMPIError* error, CMPIStatus* rc)
{
    return getMember("CMPIErrorFT.getCIMStatusCode", error, &ErrorObject::statusCode, rc);
}

CMPIString* getCIMStatusCodeDescription(const CMPIError* error, CMPIStatus* rc)
{
    return getText("CMPIErrorFT.getCIMStatusCodeDescription", error, &ErrorObject::statusCodeDescription, rc);
}

CMPIArray* getMessageArguments(const CMPIError* error, CMPIStatus* rc)
{
    return getTexts("CMPIErrorFT.getMessageArguments", error, &ErrorObject::messageArguments, rc);
}

CMPIStatus setErrorType(const CMPIError* error, const CMPIErrorType type)
{
    return setMember("CMPIErrorFT.setErrorType", error, &ErrorObject::type, type);
}

CMPIStatus setOtherErrorType(const CMPIError* error, const char* text)
{
    return setText("CMPIErrorFT.setOtherErrorType", error, &ErrorObject::otherType, text);
}

CMPIStatus setProbableCauseDescription(const CMPIError* error, const char* text)
{
    return setText("CMPIErrorFT.setProbableCauseDescription", error, &ErrorObject::probableCauseDescription,
                   text);
}

CMPIStatus setRecommendedActions(const CMPIError* error, const CMPIArray* texts)
{
    return setTexts("CMPIErrorFT.setRecommendedActions", error, &ErrorObject::recommendedActions, texts);
}

CMPIStatus setErrorSource(const CMPIError* error, const char* text)
{
    return setText("CMPIErrorFT.setErrorSource", error, &ErrorObject::source, text);
}

CMPIStatus setErrorSourceFormat(const CMPIError* error, const CMPIErrorSrcFormat format)
{
    return setMember("CMPIErrorFT.setErrorSourceFormat", error, &ErrorObject::sourceFormat, format);
}

CMPIStatus setOtherErrorSourceFormat(const CMPIError* error, const char* text)
{
    return setText("CMPIErrorFT.setOtherErrorSourceFormat", error, &ErrorObject::otherSourceFormat, text);
}

CMPIStatus setCIMStatusCodeDescription(const CMPIError* error, const char* text)
{
    return setText("CMPIErrorFT.setCIMStatusCodeDescription", error, &ErrorObject::statusCodeDescription,
                   text);
}

CMPIStatus setMessageArguments(const CMPIError* error, const CMPIArray* texts)
{
    return setTexts("CMPIErrorFT.setMessageArguments", error, &ErrorObject::messageArguments, texts);
}

} // namespace

CMPIErrorFT errorServices()
{
    return {servedVersion,
            release,
            clone,
            getErrorType,
            getOtherErrorType,
            getOwningEntity,
            getMessageID,
            getMessage,
            getPerceivedSeverity,
            getProbableCause,
            getProbableCauseDescription,
            getRecommendedActions,
            getErrorSource,
            getErrorSourceFormat,
            getOtherErrorSourceFormat,
            getCIMStatusCode,
            getCIMStatusCodeDescription,
            getMessageArguments,
            setErrorType,
            setOtherErrorType,
            setProbableCauseDescription,
            setRecommendedActions,
            setErrorSource,
            setErrorSourceFormat,
            setOtherErrorSourceFormat,
            setCIMStatusCodeDescription,
            setMessageArguments};
}

} // namespace cimhost
