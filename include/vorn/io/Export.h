#pragma once

/// Marks what the shared library exports; everything else stays hidden.
#if defined(_WIN32)
#if defined(contour_io_EXPORTS)
#define VORN_IO_EXPORT __declspec(dllexport)
#else
#define VORN_IO_EXPORT __declspec(dllimport)
#endif
#else
#define VORN_IO_EXPORT __attribute__((visibility("default")))
#endif
