// A plug-in that changes nothing: it checks its host, and its tree shows the findings.

#include "host/OpenMI.h"

#include "host/MutableNode.h"
#include "mihost/hostcheck/Run.h"

#include <cstdio>

namespace hostcheck
{

namespace
{

// Contract: scripts find the findings by these numbers.
enum NodeType : unsigned int { HostCheckType = 9001, FindingType = 9002 };
enum PropertyId : unsigned int { Name = 1, Outcome = 2, Explanation = 3 };

Run& theRun()
{
    static Run run;
    return run;
}

class HostCheck : public IC::ManagementInterface
{
public:
    IC::Error initialize(unsigned int first, IC::Number const& second,
                         IC::Number const& third) override
    {
        Run& run = theRun();
        run.checkOperations();
        IC::Error const started = ManagementInterface::initialize(first, second, third);
        unsigned int const root =
            publish(0, HostCheckType, 0, {"host check", run.failed() ? run.summary() : ""});
        unsigned int index = 0;
        for (Finding const& finding : run.findings())
            publish(root, FindingType, ++index, finding);
        if (started.getStatus() != 0)
            return started;
        std::string const problem = run.failed() ? run.summary() : run.tapProblem();
        return {static_cast<unsigned char>(problem.empty() ? 0 : 1), IC::Number(0U), problem};
    }

private:
    /** Returns the new node's id. */
    unsigned int publish(unsigned int parent, NodeType type, unsigned int index,
                         Finding const& finding)
    {
        std::string const outcome = finding.explanation.empty() ? "passed" : "failed";
        auto* const node = new IC::MutableNode(nextNodeId_++, parent, miIds_, type, index);
        nodes_.push_back(node);
        node->setStatus(1);
        node->setDescription(outcome + ": " + finding.name);
        node->setProperty(Name, IC::PropertyValue(finding.name, true));
        node->setProperty(Outcome, IC::PropertyValue(outcome, true));
        node->setProperty(Explanation, IC::PropertyValue(finding.explanation, true));
        return node->getNodeId();
    }
};

} // namespace

} // namespace hostcheck

/**
 * Returns 1, and no objects, to a host whose classes differ from those of host/: it could not use
 * them. The only place for the reason is standard error.
 */
extern "C" int OpenMI(IC::ManagementInterface** managementInterface, IC::Error** error)
{
    static bool const sound = hostcheck::theRun().checkGround();
    if (!sound) {
        std::fprintf(stderr, "mihostcheck: %s\n", hostcheck::theRun().summary().c_str());
        *managementInterface = nullptr;
        *error = nullptr;
        return 1;
    }
    static hostcheck::HostCheck interface;
    static IC::Error status(0, IC::Number(0U), "");
    *managementInterface = &interface;
    *error = &status;
    return 0;
}
