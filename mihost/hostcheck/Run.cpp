#include "mihost/hostcheck/Run.h"

#include <algorithm>
#include <exception>

namespace hostcheck
{

namespace
{

Checks joined(std::initializer_list<Checks> tables)
{
    Checks all;
    for (Checks const& table : tables)
        all.insert(all.end(), table.begin(), table.end());
    return all;
}

bool isFailure(Finding const& finding)
{
    return !finding.explanation.empty();
}

std::string outcomeOf(Check const& row)
{
    try {
        return row.run();
    } catch (std::exception const& exception) {
        return std::string("it threw: ") + exception.what();
    } catch (...) {
        return "it threw something";
    }
}

} // namespace

Run::Run()
    : ground_(joined({layoutChecks(), slotChecks()})),
      operations_(joined({valueChecks(), propertyValueChecks(), textChecks(), logChecks(),
                          lockChecks(), nodeChecks(), interfaceChecks()})),
      tap_(ground_.size() + operations_.size())
{
}

bool Run::checkGround()
{
    bool const sound = std::all_of(ground_.begin(), ground_.end(),
                                   [this](Check const& row) { return check(row); });
    if (!sound)
        tap_.bailOut("the other checks rely on this one");
    return sound;
}

void Run::checkOperations()
{
    for (Check const& row : operations_)
        check(row);
}

bool Run::check(Check const& row)
{
    std::string const name = std::string(row.operation) + ": " + row.promise;
    tap_.running(name);
    Finding const finding = {name, outcomeOf(row)};
    findings_.push_back(finding);
    tap_.result(findings_.size(), name, finding.explanation);
    return !isFailure(finding);
}

std::string Run::summary() const
{
    auto const failures = std::count_if(findings_.begin(), findings_.end(), isFailure);
    std::string const count = std::to_string(findings_.size()) + " checks";
    if (failures == 0)
        return count + " passed";
    auto const first = std::find_if(findings_.begin(), findings_.end(), isFailure);
    return std::to_string(failures) + " of " + count + " failed, the first: " + first->name + " (" +
           first->explanation + ")";
}

bool Run::failed() const
{
    return std::any_of(findings_.begin(), findings_.end(), isFailure);
}

std::string Run::tapProblem() const
{
    return holds(tap_.ready(), "MIHOSTCHECK_TAP names a file that cannot be written");
}

} // namespace hostcheck
