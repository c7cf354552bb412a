// SPDX-License-Identifier: MIT
#include "api/Link.h"
#include "ostinet/Autodetect.h"
#include "ostinet/DeviceTypeCatalog.h"
#include "ostinet/NamesCatalog.h"

// What the catalogs of device types, names and questions to instruments look like to hosts. This
// is checked by the compiler alone.

namespace Ostinet::Testing {
namespace {

static_assert(
    sizeof(Link<Mutable<Autodetect::Matcher, Autodetect::Matcher&, Autodetect::Matcher const&>>(
        &Autodetect::Matcher::operator=)) > 0,
    "");
static_assert(sizeof(Link<Const<Autodetect::Matcher, size_t>>(&Autodetect::Matcher::Start)) > 0,
              "");
static_assert(sizeof(Link<Const<Autodetect::Matcher, size_t>>(&Autodetect::Matcher::Success)) > 0,
              "");
static_assert(sizeof(Link<Const<Autodetect::Matcher, size_t, Data const&, size_t, unsigned char&,
                                Array<unsigned char, 7>&>>(&Autodetect::Matcher::Match)) > 0,
              "");

static_assert(
    sizeof(Link<Mutable<Autodetect::Response, Autodetect::Response&, Autodetect::Response const&>>(
        &Autodetect::Response::operator=)) > 0,
    "");
static_assert(
    sizeof(Link<Const<Autodetect::Response, int>>(&Autodetect::Response::CountDeviceTypeInfos)) > 0,
    "");
static_assert(sizeof(Link<Const<Autodetect::Response, DeviceTypeInfo, int>>(
                  &Autodetect::Response::GetDeviceTypeInfo)) > 0,
              "");
static_assert(sizeof(Link<Const<Autodetect::Response, int>>(&Autodetect::Response::CountRequests)) >
                  0,
              "");
static_assert(sizeof(Link<Const<Autodetect::Response, Autodetect::Request, int>>(
                  &Autodetect::Response::GetRequest)) > 0,
              "");
static_assert(sizeof(Link<Const<Autodetect::Response, Autodetect::Matcher>>(
                  &Autodetect::Response::GetMatcher)) > 0,
              "");
static_assert(
    sizeof(Link<Const<Autodetect::Response, DeviceTypeInfo, Array<unsigned char, 7> const&>>(
        &Autodetect::Response::GetMatchedDeviceTypeInfo)) > 0,
    "");

static_assert(
    sizeof(Link<Mutable<Autodetect::Request, Autodetect::Request&, Autodetect::Request const&>>(
        &Autodetect::Request::operator=)) > 0,
    "");
static_assert(sizeof(Link<Const<Autodetect::Request, DataBuffer, TimeStamp>>(
                  &Autodetect::Request::GetMessageW)) > 0,
              "");
static_assert(sizeof(Link<Const<Autodetect::Request, double>>(&Autodetect::Request::GetTimeout)) >
                  0,
              "");
static_assert(sizeof(Link<Const<Autodetect::Request, int>>(&Autodetect::Request::CountResponses)) >
                  0,
              "");
static_assert(sizeof(Link<Const<Autodetect::Request, Autodetect::Response, int>>(
                  &Autodetect::Request::GetResponse)) > 0,
              "");

static_assert(std::is_constructible<Data, unsigned char const*, size_t>::value, "");
static_assert(kIsImplicit<DataPacket, Data>, "");
static_assert(sizeof(Array<unsigned char, 7>) == 7, "");
static_assert(sizeof(MatchEntry) == 2, "");
static_assert(!std::is_default_constructible<Autodetect::Request>::value, "");
static_assert(!std::is_default_constructible<Autodetect::Response>::value, "");
static_assert(!std::is_default_constructible<Autodetect::Matcher>::value, "");
static_assert(std::is_copy_constructible<Autodetect::Request>::value, "");

static_assert(sizeof(Link<Mutable<DeviceTypeInfo, DeviceTypeInfo&, DeviceTypeInfo const&>>(
                  &DeviceTypeInfo::operator=)) > 0,
              "");
static_assert(sizeof(Link<Const<DeviceTypeInfo, bool, DeviceTypeInfo const&>>(
                  &DeviceTypeInfo::operator==)) > 0,
              "");
static_assert(sizeof(Link<Const<DeviceTypeInfo, bool, DeviceTypeInfo const&>>(
                  &DeviceTypeInfo::operator!=)) > 0,
              "");
static_assert(sizeof(Link<Const<DeviceTypeInfo, bool>>(&DeviceTypeInfo::Exists)) > 0, "");
static_assert(sizeof(Link<Const<DeviceTypeInfo, UString>>(&DeviceTypeInfo::GetMfrName)) > 0, "");
static_assert(sizeof(Link<Const<DeviceTypeInfo, UString>>(&DeviceTypeInfo::GetModelName)) > 0, "");
static_assert(
    sizeof(Link<Const<DeviceTypeInfo, bool, Device const&>>(&DeviceTypeInfo::MatchesDevice)) > 0,
    "");

static_assert(sizeof(Link<Static<DeviceTypeCatalog&>>(&DeviceTypeCatalog::Instance)) > 0, "");
static_assert(sizeof(Link<Const<DeviceTypeCatalog, int>>(&DeviceTypeCatalog::CountDeviceTypes)) > 0,
              "");
static_assert(sizeof(Link<Const<DeviceTypeCatalog, DeviceTypeInfo, int>>(
                  &DeviceTypeCatalog::GetDeviceType)) > 0,
              "");
static_assert(sizeof(Link<Const<DeviceTypeCatalog, DeviceTypeInfo, UString const&, UString const&>>(
                  &DeviceTypeCatalog::GetDeviceType)) > 0,
              "");
static_assert(
    sizeof(Link<Const<DeviceTypeCatalog, void, UString const&, std::vector<DeviceTypeInfo>&>>(
        &DeviceTypeCatalog::CollectModels)) > 0,
    "");
static_assert(
    sizeof(Link<Const<DeviceTypeCatalog, int>>(&DeviceTypeCatalog::CountAutodetectRequests)) > 0,
    "");
static_assert(sizeof(Link<Const<DeviceTypeCatalog, Autodetect::Request, int>>(
                  &DeviceTypeCatalog::GetAutodetectRequest)) > 0,
              "");

static_assert(sizeof(Link<Mutable<Impl::XMLFilesVisitor, void, File const&, bool>>(
                  &Impl::XMLFilesVisitor::Visit)) > 0,
              "");
static_assert(sizeof(Link<void (*)(Impl::XMLFilesVisitor&, char const*)>(&Impl::VisitXMLFiles)) > 0,
              "");
static_assert(
    sizeof(Link<Const<DeviceTypeCatalog, void, sorted_vector_set<UString, std::less<UString>>&>>(
        &DeviceTypeCatalog::CollectManufacturers)) > 0,
    "");

static_assert(kIsImplicit<RCPtrMT<Impl::DeviceTypeInfoImpl>, DeviceTypeInfo>, "");
static_assert(std::is_default_constructible<DeviceTypeInfo>::value, "");
static_assert(std::has_virtual_destructor<Impl::XMLFilesVisitor>::value, "");

static_assert(sizeof(Link<Const<Names, bool>>(&Names::Exists)) > 0, "");
static_assert(sizeof(Link<Const<Names, Names::Type>>(&Names::GetType)) > 0, "");
static_assert(sizeof(Link<Const<Names, FileSpecification const&>>(&Names::GetFile)) > 0, "");
static_assert(sizeof(Link<Const<Names, UString const&>>(&Names::GetName)) > 0, "");
static_assert(sizeof(Link<Const<Names, bool, Names const&>>(&Names::operator==)) > 0, "");
static_assert(sizeof(Link<Const<Names, bool, Names const&>>(&Names::operator!=)) > 0, "");

static_assert(sizeof(Link<Static<NamesCatalog&>>(&NamesCatalog::Instance)) > 0, "");
static_assert(sizeof(Link<Mutable<NamesCatalog, Names, UString const&, UString const&>>(
                  &NamesCatalog::FindMaster)) > 0,
              "");
static_assert(
    sizeof(Link<Mutable<NamesCatalog, void, UString const&, UString const&, std::vector<Names>&>>(
        &NamesCatalog::FindMasters)) > 0,
    "");
static_assert(
    sizeof(Link<Mutable<NamesCatalog, void, UString const&, UString const&, std::vector<Names>&>>(
        &NamesCatalog::FindOverrides)) > 0,
    "");
static_assert(
    sizeof(Link<Mutable<NamesCatalog, Names, UString const&>>(&NamesCatalog::FindStandardMode)) > 0,
    "");
static_assert(sizeof(Link<Mutable<NamesCatalog, void, std::vector<Names>&>>(
                  &NamesCatalog::FindStandardModes)) > 0,
              "");

static_assert(sizeof(Link<Const<DestinationMode, Destination>>(&DestinationMode::GetDestination)) >
                  0,
              "");
static_assert(sizeof(Link<Const<DestinationMode, DestinationNameSet, short>>(
                  &DestinationMode::GetNameSet)) > 0,
              "");
static_assert(sizeof(Link<Const<DestinationMode, bool>>(&DestinationMode::IsStandardMode)) > 0, "");
static_assert(sizeof(Link<Const<DestinationMode, bool>>(&DestinationMode::SelectableWithMIDI)) > 0,
              "");
static_assert(sizeof(Link<Const<DestinationMode, void, DataBuffer&, TimeStamp, unsigned char>>(
                  &DestinationMode::GetEnablingCommand)) > 0,
              "");
static_assert(sizeof(Link<Const<DestinationMode, void, DataBuffer&, TimeStamp, unsigned char>>(
                  &DestinationMode::GetDisablingCommand)) > 0,
              "");

static_assert(
    sizeof(Link<Const<DestinationNameSet, Destination>>(&DestinationNameSet::GetDestination)) > 0,
    "");
static_assert(sizeof(Link<Const<DestinationNameSet, int>>(&DestinationNameSet::CountBanks)) > 0,
              "");
static_assert(
    sizeof(Link<Const<DestinationNameSet, PatchBank, int>>(&DestinationNameSet::GetBank)) > 0, "");
static_assert(sizeof(Link<Const<DestinationNameSet, PatchBank, unsigned char, unsigned char>>(
                  &DestinationNameSet::GetBank)) > 0,
              "");
static_assert(sizeof(Link<Const<DestinationNameSet, int>>(&DestinationNameSet::CountModes)) > 0,
              "");
static_assert(
    sizeof(Link<Const<DestinationNameSet, std::pair<DestinationMode, unsigned short>, int>>(
        &DestinationNameSet::GetMode)) > 0,
    "");
static_assert(
    sizeof(Link<Const<DestinationNameSet, unsigned short>>(&DestinationNameSet::GetChannels)) > 0,
    "");

static_assert(sizeof(Link<Const<PatchBank, DestinationNameSet>>(&PatchBank::GetNameSet)) > 0, "");
static_assert(sizeof(Link<Const<PatchBank, UString>>(&PatchBank::GetBankName)) > 0, "");
static_assert(sizeof(Link<Const<PatchBank, int>>(&PatchBank::CountPatches)) > 0, "");
static_assert(sizeof(Link<Const<PatchBank, Patch, int>>(&PatchBank::GetPatch)) > 0, "");
static_assert(sizeof(Link<Const<PatchBank, unsigned char>>(&PatchBank::GetController0Number)) > 0,
              "");
static_assert(sizeof(Link<Const<PatchBank, unsigned char>>(&PatchBank::GetController32Number)) > 0,
              "");
static_assert(sizeof(Link<Const<PatchBank, DataBuffer, TimeStamp, short, unsigned char>>(
                  &PatchBank::GetCommand)) > 0,
              "");

static_assert(sizeof(Link<Const<Patch, PatchBank>>(&Patch::GetBank)) > 0, "");
static_assert(sizeof(Link<Const<Patch, UString>>(&Patch::GetNumber)) > 0, "");
static_assert(sizeof(Link<Const<Patch, UString>>(&Patch::GetNumberAndName)) > 0, "");
static_assert(sizeof(Link<Const<Patch, unsigned char>>(&Patch::GetProgramChange)) > 0, "");
static_assert(sizeof(Link<Const<Patch, PatchNumbers>>(&Patch::GetPatchNumbers)) > 0, "");
static_assert(
    sizeof(Link<Const<Patch, DataBuffer, TimeStamp, short, unsigned char>>(&Patch::GetCommand)) > 0,
    "");
static_assert(sizeof(Link<Const<Patch, NoteNameList>>(&Patch::GetNoteNames)) > 0, "");
static_assert(sizeof(Link<Const<Patch, ControlList>>(&Patch::GetControlNames)) > 0, "");

static_assert(sizeof(Link<Const<NoteNameListBase, UString>>(&NoteNameListBase::GetName)) > 0, "");
static_assert(sizeof(Link<Const<NoteNameListBase, bool>>(&NoteNameListBase::HasNames)) > 0, "");
static_assert(sizeof(Link<Const<NoteNameListBase, int>>(&NoteNameListBase::CountNoteNames)) > 0,
              "");
static_assert(sizeof(Link<Const<NoteNameListBase, std::pair<unsigned char, UString>, int>>(
                  &NoteNameListBase::GetNoteName)) > 0,
              "");
static_assert(sizeof(Link<Const<NoteNameListBase, int>>(&NoteNameListBase::CountNoteGroups)) > 0,
              "");
static_assert(
    sizeof(Link<Const<NoteNameListBase, NoteGroup, int>>(&NoteNameListBase::GetNoteGroup)) > 0, "");
static_assert(
    sizeof(Link<Const<NoteNameListBase, NoteGroup, int>>(&NoteNameListBase::GetNoteGroupForID)) > 0,
    "");
static_assert(sizeof(Link<Const<NoteNameListBase, UString, unsigned char>>(
                  &NoteNameListBase::GetNoteNameForPitch)) > 0,
              "");
static_assert(sizeof(Link<Const<NoteNameListBase, int, unsigned char>>(
                  &NoteNameListBase::GetNoteGroupForPitch)) > 0,
              "");

static_assert(sizeof(Link<Const<NoteNameList, Patch>>(&NoteNameList::GetPatch)) > 0, "");
static_assert(sizeof(Link<Const<NoteNameList, void, unsigned char, UString const&>>(
                  &NoteNameList::SetNoteName)) > 0,
              "");
static_assert(sizeof(Link<Const<NoteNameList, void, unsigned char>>(&NoteNameList::ClearNoteName)) >
                  0,
              "");
static_assert(sizeof(Link<Const<NoteNameList, void, unsigned char, int, UString const&>>(
                  &NoteNameList::PutNoteInGroup)) > 0,
              "");
static_assert(sizeof(Link<Const<NoteNameList, void, int, bool>>(&NoteNameList::RemoveNoteGroup)) >
                  0,
              "");
static_assert(sizeof(Link<Const<NoteNameList, int>>(&NoteNameList::GetUnusedGroupID)) > 0, "");

static_assert(sizeof(Link<Const<DefaultNoteNameList, DestinationNameSet>>(
                  &DefaultNoteNameList::GetNameSet)) > 0,
              "");

static_assert(sizeof(Link<Const<Control, ControlType>>(&Control::GetType)) > 0, "");
static_assert(sizeof(Link<Const<Control, unsigned short>>(&Control::GetNumber)) > 0, "");
static_assert(sizeof(Link<Const<Control, UString>>(&Control::GetName)) > 0, "");
static_assert(sizeof(Link<Const<Control, double>>(&Control::GetMinValue)) > 0, "");
static_assert(sizeof(Link<Const<Control, double>>(&Control::GetMaxValue)) > 0, "");
static_assert(sizeof(Link<Const<Control, double>>(&Control::GetDefaultValue)) > 0, "");
static_assert(sizeof(Link<Const<Control, UString>>(&Control::GetUnits)) > 0, "");
static_assert(sizeof(Link<Const<Control, bool>>(&Control::HasValueRange)) > 0, "");
static_assert(sizeof(Link<Const<Control, bool>>(&Control::HasDefaultValue)) > 0, "");
static_assert(sizeof(Link<Const<Control, bool>>(&Control::HasUnits)) > 0, "");
static_assert(sizeof(Link<Const<Control, int>>(&Control::CountValueNames)) > 0, "");
static_assert(sizeof(Link<Const<Control, std::pair<unsigned short, UString>, int>>(
                  &Control::GetValueName)) > 0,
              "");
static_assert(sizeof(Link<Const<Control, UString, unsigned short>>(&Control::GetNameForValue)) > 0,
              "");

static_assert(sizeof(Link<Const<ControlListBase, UString>>(&ControlListBase::GetName)) > 0, "");
static_assert(sizeof(Link<Const<ControlListBase, int>>(&ControlListBase::CountControls)) > 0, "");
static_assert(sizeof(Link<Const<ControlListBase, Control, ControlType, unsigned short>>(
                  &ControlListBase::GetControl)) > 0,
              "");
static_assert(sizeof(Link<Const<ControlListBase, Control, int>>(&ControlListBase::GetControl)) > 0,
              "");
static_assert(sizeof(Link<Const<ControlListBase, bool, ControlType, unsigned short>>(
                  &ControlListBase::HasControl)) > 0,
              "");

static_assert(sizeof(Link<Const<ControlList, Patch>>(&ControlList::GetPatch)) > 0, "");
static_assert(sizeof(Link<Const<ControlList, void, Control const&>>(&ControlList::SetControl)) > 0,
              "");
static_assert(sizeof(Link<Const<ControlList, void, ControlType, unsigned short>>(
                  &ControlList::ClearControl)) > 0,
              "");

static_assert(sizeof(Link<Const<DefaultControlList, DestinationNameSet>>(
                  &DefaultControlList::GetNameSet)) > 0,
              "");

static_assert(DestinationMode::kObjectID == MatchObjectID(5), "");
static_assert(DestinationNameSet::kObjectID == MatchObjectID(6), "");
static_assert(PatchBank::kObjectID == MatchObjectID(7), "");
static_assert(Patch::kObjectID == MatchObjectID(7), "");
static_assert(NoteNameList::kObjectID == MatchObjectID(9), "");
static_assert(DefaultNoteNameList::kObjectID == MatchObjectID(10), "");
static_assert(ControlList::kObjectID == MatchObjectID(11), "");
static_assert(DefaultControlList::kObjectID == MatchObjectID(12), "");
static_assert(std::is_same<decltype(DestinationMode::kNoDestinationMode), DestinationMode const>(),
              "");
static_assert(
    std::is_same<decltype(DestinationNameSet::kNoDestinationNameSet), DestinationNameSet const>(),
    "");
static_assert(std::is_same<decltype(PatchBank::kNoPatchBank), PatchBank const>(), "");
static_assert(std::is_same<decltype(Patch::kNoPatch), Patch const>(), "");
static_assert(std::is_same<decltype(NoteNameList::kNoNoteNameList), NoteNameList const>(), "");
static_assert(std::is_same<decltype(DefaultNoteNameList::kNoDefaultNoteNameList),
                           DefaultNoteNameList const>(),
              "");
static_assert(std::is_same<decltype(ControlList::kNoControlList), ControlList const>(), "");
static_assert(
    std::is_same<decltype(DefaultControlList::kNoDefaultControlList), DefaultControlList const>(),
    "");
static_assert(kIsImplicit<RCPtrMT<Impl::DestModeImpl>, DestinationMode>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::DestNameSetImpl>, DestinationNameSet>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::PatchBankImpl>, PatchBank>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::PatchImpl>, Patch>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::PatchImpl>, NoteNameList>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::PatchImpl>, ControlList>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::DestNameSetImpl>, DefaultNoteNameList>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::DestNameSetImpl>, DefaultControlList>, "");
static_assert(sizeof(DestinationMode) == kHandleSize, "");
static_assert(sizeof(DestinationNameSet) == kHandleSize, "");
static_assert(sizeof(PatchBank) == kHandleSize, "");
static_assert(sizeof(Patch) == kHandleSize, "");
static_assert(sizeof(NoteNameList) == kHandleSize, "");
static_assert(sizeof(DefaultNoteNameList) == kHandleSize, "");
static_assert(sizeof(ControlList) == kHandleSize, "");
static_assert(sizeof(DefaultControlList) == kHandleSize, "");

using Names4 = std::is_constructible<Names, Names::Type, FileSpecification, UString>;
static_assert(Names4::value, "");
static_assert(std::is_constructible<Names, Names::Type, FileSpecification>::value, "");
static_assert(Names::kMasterNames == 1 && Names::kEditedOverrideNames == 4, "");
static_assert(sizeof(PatchNumbers) == 3, "");

template <class... Arguments>
constexpr bool kMakesControl =
    std::is_constructible<Control, ControlType, unsigned short, UString, Arguments...>::value;
static_assert(std::is_default_constructible<Control>::value, "");
static_assert(kMakesControl<>, "");
static_assert(kMakesControl<double, double>, "");
static_assert(kMakesControl<double, double, UString>, "");
static_assert(kMakesControl<double, double, double>, "");
static_assert(kMakesControl<double, double, double, UString>, "");
static_assert(kMakesControl<Control::ValueMap>, "");
static_assert(kMakesControl<Control::ValueMap, unsigned short>, "");

}  // namespace
}  // namespace Ostinet::Testing
