#pragma once

#include <cairo.h>
#include <librsvg/rsvg.h>

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <string>

namespace Vorn::IO {

/// A picture in memory that answers what colours it holds.
class Picture {
 public:
  static Picture FromPng(std::string const& png) {
    Source source{png, 0};
    return Picture(cairo_image_surface_create_from_png_stream(Read, &source));
  }

  /// An SVG drawing as wide as this, in pixels; white where it cannot be drawn.
  static Picture FromSvg(std::string const& svg, int width) {
    int const height = static_cast<int>(std::lround(width * 210.0 / 297.0));
    Picture picture(cairo_image_surface_create(CAIRO_FORMAT_RGB24, width, height));
    auto const* const bytes = reinterpret_cast<guint8 const*>(svg.data());
    RsvgHandle* const handle = rsvg_handle_new_from_data(bytes, svg.size(), nullptr);
    cairo_t* const context = cairo_create(picture.surface_);
    cairo_set_source_rgb(context, 1.0, 1.0, 1.0);
    cairo_paint(context);
    RsvgRectangle const page{0.0, 0.0, static_cast<double>(width), static_cast<double>(height)};
    if (handle != nullptr) {
      rsvg_handle_render_document(handle, context, &page, nullptr);
      g_object_unref(handle);
    }
    cairo_destroy(context);
    cairo_surface_flush(picture.surface_);
    return picture;
  }

  Picture(Picture const&) = delete;
  Picture& operator=(Picture const&) = delete;
  Picture(Picture&& other) noexcept : surface_(other.surface_) { other.surface_ = nullptr; }
  ~Picture() {
    if (surface_ != nullptr) cairo_surface_destroy(surface_);
  }

  int Width() const { return cairo_image_surface_get_width(surface_); }
  int Height() const { return cairo_image_surface_get_height(surface_); }

  /// Pixels of nearly this colour, "#rrggbb".
  int Count(std::string const& color) const {
    int count = 0;
    for (int y = 0; y < Height(); ++y) {
      unsigned char const* row =
          cairo_image_surface_get_data(surface_) + y * cairo_image_surface_get_stride(surface_);
      for (int x = 0; x < Width(); ++x) count += IsNear(row + 4 * x, color) ? 1 : 0;
    }
    return count;
  }

 private:
  struct Source {
    std::string const& png;
    std::size_t at;
  };

  explicit Picture(cairo_surface_t* surface) : surface_(surface) {}

  static cairo_status_t Read(void* closure, unsigned char* data, unsigned int length) {
    Source& source = *static_cast<Source*>(closure);
    if (source.png.size() - source.at < length) return CAIRO_STATUS_READ_ERROR;
    std::copy_n(source.png.begin() + static_cast<std::ptrdiff_t>(source.at), length, data);
    source.at += length;
    return CAIRO_STATUS_SUCCESS;
  }

  /// Bytes of a pixel are blue, green, red.
  static bool IsNear(unsigned char const* pixel, std::string const& color) {
    for (int channel = 0; channel < 3; ++channel) {
      int const wanted =
          std::stoi(color.substr(1 + 2 * static_cast<std::size_t>(channel), 2), nullptr, 16);
      if (std::abs(wanted - pixel[2 - channel]) > 12) return false;
    }
    return true;
  }

  cairo_surface_t* surface_;
};

}  // namespace Vorn::IO
