#include "cim/Json.h"

#include "cim/Literal.h"
#include "cim/ObjectPathText.h"
#include "cim/StatusCode.h"
#include "cim/Values.h"

#include <cmath>

namespace cimhost::cim {

namespace {

/// One function for each kind of item.
struct JsonOf
{
    Json operator()(std::monostate /*null*/) const { return nullptr; }
    Json operator()(bool flag) const { return flag; }
    Json operator()(std::uint64_t number) const { return number; }
    Json operator()(std::int64_t number) const { return number; }
    Json operator()(double number) const
    {
        return std::isfinite(number) ? Json(number) : Json(realText(number));
    }
    Json operator()(const std::string& text) const { return text; }
    template <typename Object>
    Json operator()(const std::shared_ptr<const Object>& object) const
    {
        return object ? toJson(*object) : Json(nullptr);
    }
};

template <typename Named>
Json membersOf(const std::vector<Named>& list)
{
    Json members = Json::object();
    for (const Named& item : list)
        members[item.name] = toJson(item.value);
    return members;
}

Json textOrNull(const std::string& text)
{
    return text.empty() ? Json(nullptr) : Json(text);
}

} // namespace

Json toJson(const Value& value)
{
    if (value.isNull)
        return nullptr;
    if (!isArray(value))
        return std::visit(JsonOf{}, value.items.front());
    Json list = Json::array();
    for (const Value::Scalar& item : value.items)
        list.push_back(std::visit(JsonOf{}, item));
    return list;
}

Json toJson(const ObjectPath& path)
{
    return {{"text", toText(path)},
            {"host", textOrNull(path.host)},
            {"namespace", textOrNull(path.nameSpace)},
            {"className", path.className},
            {"keys", membersOf(path.keys)}};
}

Json toJson(const Instance& instance)
{
    return {{"path", toJson(instance.path)}, {"properties", membersOf(instance.properties)}};
}

Json toJson(const Status& status)
{
    return {{"code", static_cast<int>(status.code)},
            {"name", statusName(status.code)},
            {"message", status.message ? Json(*status.message) : Json(nullptr)}};
}

std::string toText(const Json& document)
{
    return document.dump(2, ' ', true, Json::error_handler_t::replace) + '\n';
}

} // namespace cimhost::cim
