#include <cairo.h>
#include <librsvg/rsvg.h>

#include <algorithm>
#include <cmath>
#include <memory>

#include "vorn/io/Drawing.h"
#include "vorn/io/Failure.h"

namespace Vorn::IO {

namespace {

constexpr double kPageWidthInches = 297.0 / 25.4;
constexpr double kPageHeightPerWidth = 210.0 / 297.0;

/// No picture is larger in cairo, and none needs to be.
constexpr double kMostPixels = 30000.0;

template <auto Free>
struct Freed {
  template <typename T>
  void operator()(T* object) const {
    Free(object);
  }
};

using Surface = std::unique_ptr<cairo_surface_t, Freed<cairo_surface_destroy>>;
using Context = std::unique_ptr<cairo_t, Freed<cairo_destroy>>;
using Handle = std::unique_ptr<RsvgHandle, Freed<g_object_unref>>;

/// @throws Failure with what the SVG library says.
void Require(bool isGood, GError* error) {
  if (isGood) return;
  std::string const message = error != nullptr ? error->message : "unknown reason";
  g_clear_error(&error);
  throw Failure(FailureKind::Internal, "the drawing cannot be turned into pixels: " + message);
}

Handle ReadSvg(std::string const& svg) {
  GError* error = nullptr;
  auto const* const bytes = reinterpret_cast<guint8 const*>(svg.data());
  Handle handle(rsvg_handle_new_from_data(bytes, svg.size(), &error));
  Require(handle != nullptr, error);
  return handle;
}

int WidthOf(PngSize const& size) {
  double const width = size.width ? *size.width : std::round(size.dpi * kPageWidthInches);
  if (!(width >= 1.0 && width <= kMostPixels)) {
    throw Failure(FailureKind::BadArgument, "a picture must be 1 to 30000 pixels wide");
  }
  return static_cast<int>(width);
}

cairo_status_t Append(void* closure, unsigned char const* data, unsigned int length) {
  static_cast<std::string*>(closure)->append(reinterpret_cast<char const*>(data), length);
  return CAIRO_STATUS_SUCCESS;
}

std::string EncodePng(cairo_surface_t* surface) {
  std::string png;
  cairo_status_t const status = cairo_surface_write_to_png_stream(surface, Append, &png);
  if (status != CAIRO_STATUS_SUCCESS) {
    throw Failure(FailureKind::Internal,
                  std::string("the picture cannot be made: ") + cairo_status_to_string(status));
  }
  return png;
}

}  // namespace

std::string ToPng(Drawing const& drawing, PngSize const& size) {
  int const width = WidthOf(size);
  int const height = std::max(1, static_cast<int>(std::lround(width * kPageHeightPerWidth)));
  Handle const handle = ReadSvg(ToSvg(drawing));
  Surface const surface(cairo_image_surface_create(CAIRO_FORMAT_RGB24, width, height));
  Context const context(cairo_create(surface.get()));
  RsvgRectangle const page{0.0, 0.0, static_cast<double>(width), static_cast<double>(height)};
  GError* error = nullptr;
  bool const isDrawn = rsvg_handle_render_document(handle.get(), context.get(), &page, &error) != 0;
  Require(isDrawn, error);
  return EncodePng(surface.get());
}

}  // namespace Vorn::IO
