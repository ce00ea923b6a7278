#pragma once

#include <string_view>
#include <vector>

namespace Vorn::IO {

/// What separates the fields of a line: a semicolon, a tab, a comma or, said by a blank, a stretch
/// of blanks and tabs.
///
/// A semicolon goes before a tab, a tab before a comma, a comma before blanks. But where tabs or
/// blanks stand between numbers with a decimal comma they are the separators: `1,5 2,5` are two
/// fields, `1,5, 2,5` are four. Text in double quotes is not looked into.
char FindSeparator(std::string_view line);

/// Replaces the contents of `fields` by the fields of the line, without the blanks around them. A
/// field that begins with a double quote goes on to the next one, separators included.
void SplitFields(std::string_view line, char separator, std::vector<std::string_view>* fields);

/// The field without the double quotes around it, if it has any.
std::string_view Unquoted(std::string_view field);

}  // namespace Vorn::IO
