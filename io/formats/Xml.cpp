#include "io/formats/Xml.h"

#include <expat.h>

#include <exception>
#include <memory>
#include <new>
#include <utility>

#include "io/formats/Text.h"

namespace Vorn::IO {

namespace {

/// Drawings are some ten levels deep. The parser and the readers keep something for each.
constexpr std::size_t kDeepest = 1000;

/// The parser counts bytes in 32 bits.
constexpr std::size_t kLargestText = std::size_t{1} << 30;
constexpr char kBehindNamespace = '\n';

std::string_view LocalName(char const* name) {
  std::string_view const whole(name);
  std::size_t const end = whole.rfind(kBehindNamespace);
  return end == std::string_view::npos ? whole : whole.substr(end + 1);
}

/// Between the parser, which is C and lets no exception through, and the visitor.
class Walk {
 public:
  Walk(std::string_view text, std::string path, XmlVisitor* visitor)
      : parser_(XML_ParserCreateNS(nullptr, kBehindNamespace), &XML_ParserFree),
        text_(text),
        path_(std::move(path)),
        visitor_(visitor) {
    if (!parser_) throw std::bad_alloc();
    XML_SetUserData(parser_.get(), this);
    XML_SetElementHandler(parser_.get(), &OnBegin, &OnEnd);
  }

  void Run() {
    // One call for the whole text: the parser then copies none of it for a token that goes on.
    XML_Status const status =
        XML_Parse(parser_.get(), text_.data(), static_cast<int>(text_.size()), XML_TRUE);
    if (thrown_) std::rethrow_exception(thrown_);
    if (status == XML_STATUS_OK) return;
    std::string const complaint = XML_ErrorString(XML_GetErrorCode(parser_.get()));
    throw Failure(FailureKind::File, PlaceHere(), "is not XML from here on: " + complaint);
  }

 private:
  static void XMLCALL OnBegin(void* self, XML_Char const* name, XML_Char const** attributes) {
    auto* const walk = static_cast<Walk*>(self);
    walk->Guarded([&] { walk->Begin(name, attributes); });
  }

  static void XMLCALL OnEnd(void* self, XML_Char const* /*name*/) {
    auto* const walk = static_cast<Walk*>(self);
    walk->Guarded([&] {
      --walk->depth_;
      walk->visitor_->End();
    });
  }

  template <typename Step>
  void Guarded(Step const& step) {
    if (thrown_) return;
    try {
      step();
    } catch (...) {
      thrown_ = std::current_exception();
      XML_StopParser(parser_.get(), XML_FALSE);
    }
  }

  void Begin(char const* tag, char const** attributes) {
    element_.tag = LocalName(tag);
    element_.place = PlaceHere();
    element_.attributes.clear();
    for (; *attributes != nullptr; attributes += 2) {
      element_.attributes.emplace_back(LocalName(attributes[0]), attributes[1]);
    }
    if (++depth_ > kDeepest) {
      element_.Refuse("is nested deeper than " + std::to_string(kDeepest) + " elements");
    }
    visitor_->Begin(element_);
  }

  Place PlaceHere() const {
    return {path_, static_cast<std::size_t>(XML_GetCurrentLineNumber(parser_.get())),
            static_cast<std::size_t>(XML_GetCurrentColumnNumber(parser_.get())) + 1};
  }

  std::unique_ptr<XML_ParserStruct, decltype(&XML_ParserFree)> parser_;
  std::string_view text_;
  std::string path_;
  XmlVisitor* visitor_;
  XmlElement element_;
  std::size_t depth_ = 0;
  std::exception_ptr thrown_;
};

}  // namespace

std::optional<std::string_view> XmlElement::operator[](std::string_view attribute) const {
  for (auto const& [name, value] : attributes) {
    if (name == attribute) return value;
  }
  return {};
}

void XmlElement::Refuse(std::string const& message, Remedy help) const {
  throw Failure(FailureKind::File, place, std::string(tag) + ": " + message, help);
}

void WalkXml(std::string_view text, std::string const& path, XmlVisitor* visitor) {
  if (text.size() > kLargestText) {
    RefuseFile(path, "is too large: more than " + std::to_string(kLargestText >> 20) + " MiB");
  }
  Walk(text, path, visitor).Run();
}

}  // namespace Vorn::IO
