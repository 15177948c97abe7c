#ifndef SYSDATA_PARAMINFO_H
#define SYSDATA_PARAMINFO_H

#include <string>

namespace NQ
{

/** One parameter of an administration method. */
struct ParamInfo {
    std::string name;  // such as "UserName"
    std::string type;  // "CMPI_string", "CMPI_uint32" or "CMPI_dateTime"
    std::string value; // a date as year-month-day, without zero padding
};

} // namespace NQ

#endif
