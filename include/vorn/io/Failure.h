#pragma once

#include <cstddef>
#include <stdexcept>
#include <string>

#include "vorn/io/Export.h"

namespace Vorn::IO {

/// What went wrong, for a caller who acts on it.
enum class FailureKind {
  BadArgument,     ///< what the caller asks for cannot be, whatever the files hold
  File,            ///< a file cannot be read or written, or holds something else than it should
  PointsTooClose,  ///< two neighbouring points are too close for their tolerances
  NoFit,           ///< the points have no contour within their tolerances
  Internal,        ///< a defect of this library
};

/// What would help, for a program that tells its user how to say it.
enum class Remedy {
  None,           ///< nothing but another input
  ChooseColumns,  ///< saying which columns hold the points
  ChooseUnits,    ///< saying in which unit the coordinates are
  GiveTolerance,  ///< a tolerance, or a column with one for each point
  CloseContour,   ///< saying that the contour is closed
  FlattenCurves,  ///< saying how far chords may be from arcs and curves that are read
  GiveChords,     ///< saying how far chords may be from arcs that are written
  SpacePoints,    ///< smaller tolerances, fewer points, or the fewest pieces; see SpacingFailure
  LeaveOneOut,    ///< leaving out one of two points in one place; see SpacingFailure
};

/// Where something is wrong.
struct Place {
  std::string file;        ///< as messages call it: its path, or "standard input"
  std::size_t line = 0;    ///< counted from 1; 0: it is not about one line
  std::size_t column = 0;  ///< in characters, counted from 1; 0: it is not about one column
};

/// The exception with which every operation of this library fails. what() is a sentence for the
/// user that begins with the place: "scan.csv:3:7: 'abc' is not a number".
class VORN_IO_EXPORT Failure : public std::runtime_error {
 public:
  /// About no file.
  Failure(FailureKind kind, std::string const& message);

  /// About a file, one of its lines or a place in a line, with what would help.
  Failure(FailureKind kind, Place place, std::string const& message, Remedy help = Remedy::None);

  /// Failures are copied when they are thrown and caught.
  Failure(Failure const&) = default;
  /// The same for one that is there already.
  Failure& operator=(Failure const&) = default;
  /// Out of line, so that every library knows the same type.
  ~Failure() override;

  /// What went wrong.
  FailureKind Kind() const { return kind_; }

  /// The file is empty where the failure is about none.
  Place const& Where() const { return place_; }

  /// what() without the place.
  std::string const& Message() const { return message_; }

  /// What would help.
  Remedy Help() const { return help_; }

 private:
  FailureKind kind_;     ///< what went wrong
  Place place_;          ///< where
  std::string message_;  ///< without the place
  Remedy help_;          ///< what would help
};

}  // namespace Vorn::IO
