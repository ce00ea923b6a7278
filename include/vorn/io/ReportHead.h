#pragma once

#include <string>
#include <vector>

namespace Vorn::IO {

/// A name and what the user says of it: "operator", "Jones".
struct ReportField {
  std::string name;   ///< not empty
  std::string value;  ///< may be empty
};

/// What stands at the head of a report, besides what was measured.
struct ReportHead {
  std::vector<ReportField> fields;  ///< part, drawing number, operator, date, in the order to show
  std::string program;              ///< name and version of what made the report; may be empty
};

}  // namespace Vorn::IO
