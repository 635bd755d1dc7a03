#include "serve/ClassRequests.h"

#include "schema/MofReader.h"

#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace cimhost;
using namespace cimhost::serve;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

class ClassRequests : public testing::Test
{
protected:
    ClassRequests()
    {
        question.step = Step::getClass;
        question.request.target = {"", "root/a", "CIM_Leaf", {}};
    }

    std::vector<std::string> namesFound(const std::string& className, bool isDeep)
    {
        question.step = Step::enumerateClassNames;
        question.request.target.className = className;
        question.deepInheritance = isDeep;
        const Reply reply = findClasses(question, broker);
        EXPECT_EQ(reply.answer.status.code, CMPI_RC_OK) << reply.answer.status.message.value_or("");
        std::vector<std::string> names;
        for (const schema::Class& found : reply.classes)
            names.push_back(found.name);
        return names;
    }

    schema::Class leaf()
    {
        const Reply reply = findClasses(question, broker);
        return reply.classes.empty() ? schema::Class() : reply.classes.front();
    }

    std::vector<std::string> properties()
    {
        std::vector<std::string> names;
        for (const schema::Property& property : leaf().properties)
            names.push_back(property.name);
        return names;
    }

    Registration registration{
        {{"CIM_Leaf", "P", "L", true, false, {"root/a"}}, {"CIM_Other", "P", "L", true, false, {"root/b"}}}};
    Broker broker{registration,
                  {},
                  {},
                  nullptr,
                  schema::Classes(schema::readMof(R"([Description("base")] class CIM_Base {
                                                         [Key] string Id; uint16 State; };
                                                     class CIM_Other : CIM_Base {};
                                                     [Version("1")] class CIM_Leaf : CIM_Base {
                                                         [Override("State"), Description("own")] uint16 State;
                                                         string Own; };)",
                                                  "a.mof")
                                      .classes)};
    Question question;
};

TEST_F(ClassRequests, getOfAClassWhatItDeclaresItself)
{
    EXPECT_THAT(properties(), ElementsAre("State", "Own"));
    ASSERT_EQ(leaf().qualifiers.size(), 1U);
    EXPECT_EQ(leaf().qualifiers[0].name, "Version");
    EXPECT_EQ(leaf().properties[0].qualifiers.size(), 2U);
    EXPECT_EQ(leaf().properties[0].origin, "");
}

TEST_F(ClassRequests, getWhatAClassInheritsWhenAsked)
{
    question.localOnly = false;
    question.includeClassOrigin = true;
    EXPECT_THAT(properties(), ElementsAre("Id", "State", "Own"));
    EXPECT_EQ(leaf().qualifiers.size(), 2U);
    EXPECT_EQ(leaf().properties[0].origin, "CIM_Base");
    EXPECT_EQ(leaf().properties[0].qualifiers[0].name, "Key");
}

TEST_F(ClassRequests, leaveQualifiersAndPropertiesOut)
{
    question.localOnly = false;
    question.includeQualifiers = false;
    question.request.properties = {"STATE", "None"};
    EXPECT_THAT(properties(), ElementsAre("State"));
    EXPECT_THAT(leaf().qualifiers, IsEmpty());
    EXPECT_THAT(leaf().properties[0].qualifiers, IsEmpty());
    question.request.properties.emplace();
    EXPECT_THAT(properties(), IsEmpty());
}

TEST_F(ClassRequests, enumerateClassesOfTheNamespace)
{
    EXPECT_THAT(namesFound("", false), ElementsAre("CIM_Base"));
    EXPECT_THAT(namesFound("", true), ElementsAre("CIM_Base", "CIM_Leaf"));
    EXPECT_THAT(namesFound("cim_base", false), ElementsAre("CIM_Leaf"));
    EXPECT_THAT(namesFound("CIM_Leaf", true), IsEmpty());
    question.request.target.nameSpace = "ROOT/B";
    EXPECT_THAT(namesFound("", true), ElementsAre("CIM_Base", "CIM_Other"));
}

TEST_F(ClassRequests, enumerateDeclarations)
{
    question.step = Step::enumerateClasses;
    question.request.target.className = "CIM_Base";
    EXPECT_THAT(properties(), ElementsAre("State", "Own"));
}

TEST_F(ClassRequests, refuseWhatIsNotThere)
{
    const auto code = [&](Step step, const char* className, const char* nameSpace) {
        question.step = step;
        question.request.target = {"", nameSpace, className, {}};
        return findClasses(question, broker).answer.status.code;
    };
    EXPECT_EQ(code(Step::getClass, "CIM_None", "root/a"), CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(code(Step::getClass, "", "root/a"), CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(code(Step::getClass, "CIM_Other", "root/a"), CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(code(Step::enumerateClasses, "CIM_None", "root/a"), CMPI_RC_ERR_INVALID_CLASS);
    EXPECT_EQ(code(Step::enumerateClassNames, "CIM_Other", "root/a"), CMPI_RC_ERR_INVALID_CLASS);
    for (const Step step : {Step::getClass, Step::enumerateClasses, Step::enumerateClassNames})
        EXPECT_EQ(code(step, "CIM_Leaf", "root/none"), CMPI_RC_ERR_INVALID_NAMESPACE);
}

} // namespace
