// A plug-in with one node of an unknown kind. The environment variable ODD selects a behaviour that
// the real plug-in never has.

#include "host/MutableNode.h"
#include "host/OpenMI.h"
#include "host/Properties.h"

#include <cstdlib>
#include <string>

namespace
{

bool isOddIn(char const* what)
{
    char const* const odd = std::getenv("ODD");
    return odd && std::string(odd) == what;
}

class Odd : public IC::ManagementInterface
{
public:
    IC::Error initialize(unsigned int first, IC::Number const& second,
                         IC::Number const& third) override
    {
        ManagementInterface::initialize(first, second, third);
        auto* const node = new IC::MutableNode(nextNodeId_++, 0, miIds_, 99, 0);
        node->setProperty(7, IC::PropertyValue("seven", true));
        nodes_.push_back(node);
        return {static_cast<unsigned char>(isOddIn("start") ? 5 : 0), IC::Number(0U), "no reason"};
    }

    /** With "rebuild", builds the group "crew" again at each call, its GID the number of calls. */
    IC::Error getMap(std::vector<IC::Node*>& nodes) override
    {
        if (isOddIn("rebuild") || isOddIn("vanish"))
            rebuild();
        return ManagementInterface::getMap(nodes);
    }

private:
    void rebuild()
    {
        if (crew_)
            deleteNode(crew_);
        crew_ = nullptr;
        ++rebuilt_;
        if (isOddIn("vanish") && rebuilt_ % 2 == 0)
            return;
        crew_ = new IC::MutableNode(nextNodeId_++, 0, miIds_, IC::nodeType::group, 1);
        crew_->setProperty(IC::property::name, IC::PropertyValue("crew", true));
        crew_->setProperty(IC::property::id, IC::PropertyValue(IC::Number(rebuilt_), true));
        IC::Node* node = crew_;
        addNewNode(node);
    }

    IC::MutableNode* crew_ = nullptr;
    unsigned int rebuilt_ = 0;
};

} // namespace

extern "C" int OpenMI(IC::ManagementInterface** interface, IC::Error** error)
{
    static Odd odd;
    static IC::Error status(0, IC::Number(0U), "");
    *interface = isOddIn("interface") ? nullptr : &odd;
    *error = &status;
    return isOddIn("answer") ? 7 : 0;
}
