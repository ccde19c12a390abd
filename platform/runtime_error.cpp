#include "platform/runtime_error.h"

namespace frontpanels {

void raiseInvalidProcedureCall() { throw RuntimeError(5, "Invalid procedure call or argument"); }
void raiseOverflow() { throw RuntimeError(6, "Overflow"); }
void raiseOutOfMemory() { throw RuntimeError(7, "Out of memory"); }
void raiseSubscriptOutOfRange() { throw RuntimeError(9, "Subscript out of range"); }
void raiseDivisionByZero() { throw RuntimeError(11, "Division by zero"); }
void raiseTypeMismatch() { throw RuntimeError(13, "Type mismatch"); }
void raiseFileNotFound() { throw RuntimeError(53, "File not found"); }
void raiseDeviceIoError() { throw RuntimeError(57, "Device I/O error"); }
void raisePermissionDenied() { throw RuntimeError(70, "Permission denied"); }
void raisePathFileAccessError() { throw RuntimeError(75, "Path/File access error"); }
void raiseObjectVariableNotSet() { throw RuntimeError(91, "Object variable or With block variable not set"); }
void raiseInvalidUseOfNull() { throw RuntimeError(94, "Invalid use of Null"); }
void raiseInvalidFileFormat() { throw RuntimeError(321, "Invalid file format"); }
void raiseMemberNotSupported() { throw RuntimeError(438, "Object doesn't support this property or method"); }
void raiseDuplicateKey() {
  throw RuntimeError(457, "This key is already associated with an element of this collection");
}

}  // namespace frontpanels
