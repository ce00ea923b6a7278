#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "vorn/io/Failure.h"

namespace Vorn::IO {

/// The start tag of an element. The texts live as long as the call that gets it.
struct XmlElement {
  std::string_view tag;  ///< its name without the namespace
  std::vector<std::pair<std::string_view, std::string_view>> attributes;
  Place place;  ///< of the tag

  /// The value of an attribute, if the element has it.
  std::optional<std::string_view> operator[](std::string_view attribute) const;

  /// Ends the reading with a message about this element.
  [[noreturn]] void Refuse(std::string const& message, Remedy help = Remedy::None) const;
};

/// Gets the elements of a document in its order.
class XmlVisitor {
 public:
  /// Visitors are owned by their classes.
  virtual ~XmlVisitor() = default;
  /// An element begins; those inside follow.
  virtual void Begin(XmlElement const& element) = 0;
  /// The element that began last and has not ended ends.
  virtual void End() = 0;
};

/// Goes through the text; what the visitor throws comes out.
/// @throws Failure (FailureKind::File) with line and column when the text is not well-formed, is
///         nested deeper than any drawing, or is larger than the parser takes.
void WalkXml(std::string_view text, std::string const& path, XmlVisitor* visitor);

}  // namespace Vorn::IO
