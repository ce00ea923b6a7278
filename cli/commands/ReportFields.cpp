#include "cli/commands/ReportFields.h"

#include <algorithm>

#include "vorn/io/Failure.h"
#include "vorn/io/Messages.h"

namespace Vorn::Cli {

namespace {

[[noreturn]] void Refuse(std::string const& message) {
  throw Failure(FailureKind::BadArgument, "--field " + message);
}

ReportField FieldOf(std::string const& text) {
  std::size_t const sign = text.find('=');
  if (sign == std::string::npos || sign == 0) {
    Refuse(Quoted(text) + ": NAME=VALUE is wanted, such as part=Cam");
  }
  return {Printable(text.substr(0, sign)), Printable(text.substr(sign + 1))};
}

}  // namespace

void AddFieldOption(Command& command, std::vector<std::string>* texts) {
  command.AddRepeatable(
      "--field", texts, "NAME=VALUE",
      "Put this into the report: part, drawing, operator, date or what you like; may be given "
      "several times");
}

ReportHead HeadOf(std::vector<std::string> const& texts) {
  ReportHead head;
  head.program = "contour " CONTOUR_VERSION;
  for (std::string const& text : texts) {
    ReportField const field = FieldOf(text);
    bool const isTwice =
        std::any_of(head.fields.begin(), head.fields.end(),
                    [&](ReportField const& other) { return other.name == field.name; });
    if (isTwice) Refuse(Quoted(field.name) + " is given twice");
    head.fields.push_back(field);
  }
  return head;
}

}  // namespace Vorn::Cli
