#pragma once

#include <cstdint>
#include <string>

#include "io/formats/DxfWriter.h"

/// The objects of DXF 2000: each has a handle of its own, names its owner and tells its classes.
namespace Vorn::IO::Dxf {

/// A number that names an object of the drawing.
using Handle = std::uint32_t;

/// No object: the owner of what nothing owns.
inline constexpr Handle kNobody = 0;

/// The handle as files hold it, in hexadecimal.
std::string Written(Handle handle);

/// The text of a file whose objects get handles in the order in which they are begun.
class Objects : public Writer {
 public:
  /// Gives the object that was begun its handle and its owner.
  /// @param code the group of the handle, which is another one for dimension styles
  Handle Name(Handle owner, int code = 5);

  /// Says that the groups that follow belong to this class of the object.
  void Class(char const* name);

  /// Begins a table of this many records.
  /// @return its handle, the owner of the records
  Handle BeginTable(char const* name, int count);

  /// Ends the table begun last.
  void EndTable();

  /// A record of a table up to its name.
  Handle BeginRecord(char const* type, char const* subclass, std::string const& name, Handle table);

  /// An entity of a block up to its layer; one on paper says so.
  void BeginEntity(char const* type, char const* layer, Handle owner, bool isOnPaper = false);

  /// The handle that the next object gets; no object has it yet.
  Handle Next() const { return next_; }

 private:
  Handle next_ = 1;
};

}  // namespace Vorn::IO::Dxf
