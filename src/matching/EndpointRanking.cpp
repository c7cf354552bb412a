// SPDX-License-Identifier: MIT
//
// How alike a reference and a live endpoint are: one rank for each criterion, and -1 where the
// reference says nothing of it, which is no lower grade than 0.
//
// A host compares each of its references with each endpoint, so this allocates nothing once the
// texts below have grown to the length of the studio's names.
#include "core/PerThread.h"
#include "matching/SavedEndpoint.h"
#include "model/Handles.h"
#include "model/PropertyKeys.h"
#include "ostinet/Setup.h"

namespace Ostinet {

namespace {

using Impl::EncodedText;
using Impl::EndpointImpl;
using Impl::SavedEndpoint;
namespace Keys = Impl::Keys;

// Texts of this thread that keep their room from one comparison to the next.
struct Texts {
  UString decoded;
  UString live;
};

Texts& TheTexts() {
  static PerThread<Texts> sTexts;
  return *sTexts;
}

enum class Likeness { kDifferent, kLoose, kExact };

Likeness Compare(EncodedText const& saved, UString const& live) {
  if (saved.Equals(live)) {
    return Likeness::kExact;
  }
  UString& decoded = TheTexts().decoded;
  saved.DecodeTo(decoded);
  return decoded.equal(live, UString::kLooselyEqual) ? Likeness::kLoose : Likeness::kDifferent;
}

Likeness CompareProperty(EncodedText const& saved, EndpointImpl const& live, UString const& key) {
  UString& text = TheTexts().live;
  text.clear();
  live.Peer()->GetString(key, text);
  return Compare(saved, text);
}

int RankOf(Likeness likeness) { return static_cast<int>(likeness); }

void RankUniqueID(SavedEndpoint const& saved, EndpointImpl const& live, ObjectMatch& match) {
  bool const isSameKind = !saved.isSoftware || *saved.isSoftware == live.IsSoftware();
  if (saved.uniqueID != 0 && isSameKind) {
    bool const isSame = saved.uniqueID == live.GetInt(Keys::kUniqueID, 0);
    match.SetRank(ObjectMatch::kUniqueIDMatch, isSame ? 2 : 0);
  }
}

void RankName(SavedEndpoint const& saved, EndpointImpl const& live, ObjectMatch& match) {
  UString& name = TheTexts().live;
  name.clear();
  if (saved.nameIsFull) {
    name = live.NameToShow();
  } else {
    live.Peer()->GetString(Keys::kName, name);
  }
  if (!name.empty()) {
    match.SetRank(ObjectMatch::kNameMatch, RankOf(Compare(saved.name, name)));
  }
}

//   maker       model       rank
//   exact       exact       4
//   not other   not other   3
//   exact       other       2
//   loose       other       1
//   other       any         0
int RankOf(Likeness manufacturer, Likeness model) {
  if (manufacturer == Likeness::kDifferent) {
    return 0;
  }
  if (model == Likeness::kDifferent) {
    return RankOf(manufacturer);
  }
  bool const isExact = manufacturer == Likeness::kExact && model == Likeness::kExact;
  return isExact ? 4 : 3;
}

void RankDevice(SavedEndpoint const& saved, EndpointImpl const& live, ObjectMatch& match) {
  if (!saved.model.empty()) {
    int const rank = RankOf(CompareProperty(saved.manufacturer, live, Keys::kManufacturer),
                            CompareProperty(saved.model, live, Keys::kModel));
    match.SetRank(ObjectMatch::kManufacturerModelMatch, rank);
  }
}

void RankConnection(SavedEndpoint const& saved, EndpointImpl const& live, ObjectMatch& match) {
  bool const wasExternal =
      saved.isDirect && !*saved.isDirect && saved.isSoftware && !*saved.isSoftware;
  if (saved.connectionUniqueID != 0 && wasExternal) {
    EndpointImpl const* const port = live.IsDirect() ? nullptr : live.GetDirectEndpoint();
    bool const isSame =
        port != nullptr && port->GetInt(Keys::kUniqueID, 0) == saved.connectionUniqueID;
    match.SetRank(ObjectMatch::kConnectionMatch, isSame ? 1 : 0);
  }
}

void RankGeneralMIDI(SavedEndpoint const& saved, EndpointImpl const& live, ObjectMatch& match) {
  if (saved.supportsGeneralMIDI) {
    bool const supports = live.GetInt(Keys::kSupportsGeneralMIDI, 0) != 0;
    int const rankIfSame = supports ? 2 : 1;
    match.SetRank(ObjectMatch::kGeneralMIDIMatch,
                  supports == *saved.supportsGeneralMIDI ? rankIfSame : 0);
  }
}

// An instrument within the host is told by its slot alone: it may bear any name.
bool RankSlot(SavedEndpoint const& saved, EndpointImpl const& live, ObjectMatch& match) {
  if (!saved.isInternalSoftware.value_or(false) || !live.IsInternalSoftware() || !saved.slot) {
    return false;
  }
  bool const isSame = *saved.slot != SlotID() && *saved.slot == live.GetSlotID();
  match.SetRank(ObjectMatch::kUniqueIDMatch, isSame ? 2 : 0);
  return true;
}

}  // namespace

ObjectMatch Endpoint::MatchToData(MatchData const& data) const {
  ObjectMatch match;
  EndpointImpl const* const live = Impl::ImplOf(*this);
  if (live == nullptr || !live->Peer()->ReallyExists()) {
    return match;
  }
  SavedEndpoint const saved(data, live->GetSetup().GetProperties().GetImplementation());
  if (!saved.isValid || saved.objectType != live->GetObjectID() || RankSlot(saved, *live, match)) {
    return match;
  }
  RankUniqueID(saved, *live, match);
  RankName(saved, *live, match);
  RankDevice(saved, *live, match);
  RankConnection(saved, *live, match);
  RankGeneralMIDI(saved, *live, match);
  return match;
}

}  // namespace Ostinet
