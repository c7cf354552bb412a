// SPDX-License-Identifier: MIT
#include "matching/MatchDataReader.h"
#include "ostinet/Setup.h"

namespace Ostinet {

namespace {

// Section 1 means something to the backend alone that wrote it.
int WantedUniqueID(Impl::MatchDataReader const& reader, Properties const& properties) {
  bool const isOurs =
      reader.GetImplementation() == static_cast<unsigned int>(properties.GetImplementation());
  int id = 0;
  if (isOurs && reader.GetSection1().version == 0) {
    reader.GetSection1Stream().ReadInt32(id);
  }
  return id;
}

}  // namespace

std::pair<Source, Destination> Setup::CreateVirtualEndpoint(MatchData const& reference,
                                                            SrcOrDest source,
                                                            SrcOrDest destination) {
  Impl::MatchDataReader const reader(reference);
  if (!reader.IsValid() || !reader.NamesEndpoint()) {
    return {};
  }
  auto const ends = PlatformCreateVirtualEndpoint(
      reader.GetName().Decode(), WantedUniqueID(reader, GetProperties()), source, destination);
  return {Source(ends.first), Destination(ends.second)};
}

}  // namespace Ostinet
