#include "Tape.h"

namespace bench {

Tape::Tape() : words(fixedWords), shown{"null", "broker", "ctx", "rslt", "ref", "rc", "-", "count"} {}

std::vector<Tape::Step>& Tape::steps()
{
    static std::vector<Step> all;
    return all;
}

Tape::Number Tape::addStep(Step step)
{
    steps().push_back(std::move(step));
    return static_cast<Number>(steps().size() - 1);
}

void Tape::replay(const TapeRequest& request)
{
    CMPIStatus status{CMPI_RC_OK, nullptr};
    words[brokerWord].pointer = const_cast<CMPIBroker*>(request.broker);
    words[contextWord].pointer = const_cast<CMPIContext*>(request.ctx);
    words[resultWord].pointer = const_cast<CMPIResult*>(request.rslt);
    words[pathWord].pointer = const_cast<CMPIObjectPath*>(request.ref);
    words[statusWord].pointer = &status;
    const Step* const known = steps().data();
    Word* const places = words.data();
    const Number* const end = code.data() + code.size();
    for (const Number* next = code.data(); next != end;)
        next = known[*next].make(next + 1, places);
}

std::vector<std::string> Tape::calls() const
{
    std::vector<std::string> all;
    for (auto next = code.begin(); next != code.end();) {
        const Step& step = steps()[*next++];
        std::string call = step.name + '(';
        for (std::size_t i = 0; i < step.numbers; ++i)
            call += (i == 0 ? "" : ", ") + shown[*next++ & ~textInPlaceOfValue];
        all.push_back(call + ')');
    }
    return all;
}

} // namespace bench
