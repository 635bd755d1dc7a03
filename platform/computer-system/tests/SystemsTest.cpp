#include "ComputerSystemTest.h"

#include <algorithm>

#include <Tavro/Common.h>

namespace {

using cimhost::cim::Answer;
using cimhost::cim::ObjectPath;
using testing::ElementsAre;
using testing::IsEmpty;

class Systems : public ComputerSystemTest
{
protected:
    /// The names that the provider answers with, which are the same for paths and instances.
    std::vector<std::string> names()
    {
        const Answer paths = broker.enumerateInstanceNames(classPath());
        const Answer instances = broker.enumerateInstances(classPath());
        EXPECT_EQ(paths.status.code, CMPI_RC_OK);
        EXPECT_EQ(instances.status.code, CMPI_RC_OK);

        std::vector<std::string> result;
        std::transform(paths.paths.begin(), paths.paths.end(), std::back_inserter(result), nameIn);
        std::vector<std::string> ofInstances;
        for (const auto& instance : instances.instances)
            ofInstances.push_back(nameIn(instance.path));
        EXPECT_EQ(ofInstances, result);
        return result;
    }

private:
    static std::string nameIn(const ObjectPath& path)
    {
        const cimhost::cim::Value* const name = cimhost::cim::findKey(path, "Name");
        return name != nullptr ? std::get<std::string>(name->items.at(0)) : "no key";
    }
};

TEST_F(Systems, IsTheHostWhenTheVariableIsNotSet)
{
    systems.set(std::nullopt);
    EXPECT_THAT(names(), ElementsAre(Tavro::getSystemName()));
}

TEST_F(Systems, AreThoseOfTheVariableInItsOrder)
{
    systems.set("gamma,alpha,beta");
    EXPECT_THAT(names(), ElementsAre("gamma", "alpha", "beta"));
}

TEST_F(Systems, AreNoneWhenTheVariableIsEmpty)
{
    systems.set("");
    EXPECT_THAT(names(), IsEmpty());
}

TEST_F(Systems, AreNoneWhenTheVariableHoldsBlanksAndCommasOnly)
{
    systems.set(" , ,");
    EXPECT_THAT(names(), IsEmpty());
}

TEST_F(Systems, LoseBlanksAroundThemAndEmptyOnes)
{
    systems.set(" alpha ,, beta gamma,");
    EXPECT_THAT(names(), ElementsAre("alpha", "beta gamma"));
}

TEST_F(Systems, AreServedOnceHoweverOftenTheyAreNamed)
{
    systems.set("alpha,beta, alpha");
    EXPECT_THAT(names(), ElementsAre("alpha", "beta"));
}

TEST_F(Systems, AreReadAnewByEachRequest)
{
    systems.set("alpha");
    EXPECT_THAT(names(), ElementsAre("alpha"));
    systems.set("beta");
    EXPECT_THAT(names(), ElementsAre("beta"));
}

} // namespace
