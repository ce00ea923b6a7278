#include "io/formats/DxfObjects.h"

#include <cstdio>

namespace Vorn::IO::Dxf {

std::string Written(Handle handle) {
  char text[16];
  std::snprintf(text, sizeof text, "%X", handle);
  return text;
}

Handle Objects::Name(Handle owner, int code) {
  Group(code, Written(next_));
  Group(330, Written(owner));
  return next_++;
}

void Objects::Class(char const* name) { Group(100, name); }

Handle Objects::BeginTable(char const* name, int count) {
  Group(0, "TABLE");
  Group(2, name);
  Handle const handle = Name(kNobody);
  Class("AcDbSymbolTable");
  Group(70, std::to_string(count));
  return handle;
}

void Objects::EndTable() { Group(0, "ENDTAB"); }

Handle Objects::BeginRecord(char const* type, char const* subclass, std::string const& name,
                            Handle table) {
  Group(0, type);
  Handle const handle = Name(table, std::string(type) == "DIMSTYLE" ? 105 : 5);
  Class("AcDbSymbolTableRecord");
  Class(subclass);
  Group(2, name);
  return handle;
}

void Objects::BeginEntity(char const* type, char const* layer, Handle owner, bool isOnPaper) {
  Group(0, type);
  Name(owner);
  Class("AcDbEntity");
  if (isOnPaper) Group(67, "1");
  Group(8, layer);
}

}  // namespace Vorn::IO::Dxf
