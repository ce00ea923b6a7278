#include "io/formats/NamedFields.h"

#include <algorithm>
#include <array>
#include <ctime>

#include "vorn/io/Failure.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

constexpr char const* kLetters = "abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ";

std::string ValueOf(std::string const& name, std::vector<NamedField> const& fields) {
  std::string names;
  for (NamedField const& field : fields) {
    if (field.name == name) return field.value;
    names += (names.empty() ? "{" : ", {") + field.name + "}";
  }
  throw Failure(FailureKind::BadArgument,
                Quoted("{" + name + "}") + " is none of the fields " + names);
}

}  // namespace

std::string FilledIn(std::string const& text, std::vector<NamedField> const& fields) {
  std::string result;
  std::size_t at = 0;
  while (at < text.size()) {
    std::size_t const end = text.find_first_not_of(kLetters, at + 1);
    bool const isField =
        text[at] == '{' && end != std::string::npos && end > at + 1 && text[end] == '}';
    result += isField ? ValueOf(text.substr(at + 1, end - at - 1), fields) : text.substr(at, 1);
    at = isField ? end + 1 : at + 1;
  }
  return result;
}

std::string Today() {
  std::time_t const now = std::time(nullptr);
  std::tm local{};
  localtime_r(&now, &local);
  std::array<char, 16> date{};
  std::strftime(date.data(), date.size(), "%Y-%m-%d", &local);
  return date.data();
}

}  // namespace Vorn::IO
