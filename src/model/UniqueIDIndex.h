// SPDX-License-Identifier: MIT
#pragma once

namespace Ostinet::Impl {

// Which numbers stand under "uniqueID" in any property store of the process.
//
// A number that is not here is in use nowhere, so drawing a free one needs no walk over the
// studio. One that is here may belong to an object that has left: then the walk decides. Stores
// keep this right by themselves, whatever road a property took into them.
//
// Threads      [any thread] The last handle of an object, and so its store, may go on any thread.

void NoteStoredUniqueID(int id);
void ForgetStoredUniqueID(int id);
bool IsUniqueIDStored(int id);

}  // namespace Ostinet::Impl
