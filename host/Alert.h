#ifndef HOST_ALERT_H
#define HOST_ALERT_H

#include <string>

namespace IC
{

/** An event that an interface reports to its host. This management interface raises none. */
class Alert
{
public:
    Alert(unsigned int nodeId, std::string const& text);
    Alert(Alert const& other);
    Alert& operator=(Alert const& other);
    ~Alert();

    unsigned int getNodeId() const;
    std::string getText() const;

private:
    unsigned int nodeId_;
    std::string text_;
};

} // namespace IC

#endif
