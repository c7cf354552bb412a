// SPDX-License-Identifier: MIT
#include "platform/system/windows/WindowsAudioSessions.h"

#include <audiopolicy.h>
#include <mmdeviceapi.h>

#include "platform/system/windows/ComPtr.h"

namespace Ostinet::Impl {
namespace {

ComPtr<IMMDeviceCollection> ListRenderDevices() {
  auto const enumerator = MakeCom<IMMDeviceEnumerator>([](IMMDeviceEnumerator** result) {
    return ::CoCreateInstance(__uuidof(MMDeviceEnumerator), nullptr, CLSCTX_INPROC_SERVER,
                              __uuidof(IMMDeviceEnumerator), reinterpret_cast<void**>(result));
  });
  if (!enumerator) return nullptr;
  return MakeCom<IMMDeviceCollection>([&](IMMDeviceCollection** result) {
    return enumerator->EnumAudioEndpoints(eRender, DEVICE_STATE_ACTIVE, result);
  });
}

ComPtr<IAudioSessionEnumerator> ListSessions(IMMDevice& device) {
  auto const manager = MakeCom<IAudioSessionManager2>([&](IAudioSessionManager2** result) {
    return device.Activate(__uuidof(IAudioSessionManager2), CLSCTX_INPROC_SERVER, nullptr,
                           reinterpret_cast<void**>(result));
  });
  if (!manager) return nullptr;
  return MakeCom<IAudioSessionEnumerator>(
      [&](IAudioSessionEnumerator** result) { return manager->GetSessionEnumerator(result); });
}

void AppendIfOwn(IAudioSessionControl& control, std::vector<AudioSession>& sessions) {
  auto const session = MakeCom<IAudioSessionControl2>([&](IAudioSessionControl2** result) {
    return control.QueryInterface(__uuidof(IAudioSessionControl2),
                                  reinterpret_cast<void**>(result));
  });
  DWORD process = 0;
  if (!session || FAILED(session->GetProcessId(&process)) || process != ::GetCurrentProcessId()) {
    return;
  }
  LPWSTR identifier = nullptr;
  if (FAILED(session->GetSessionInstanceIdentifier(&identifier)) || identifier == nullptr) return;
  std::wstring const text = identifier;
  ::CoTaskMemFree(identifier);
  sessions.push_back({std::u16string(text.begin(), text.end())});
}

void AppendOwnSessions(IMMDevice& device, std::vector<AudioSession>& sessions) {
  auto const list = ListSessions(device);
  int count = 0;
  if (!list || FAILED(list->GetCount(&count))) return;
  for (int i = 0; i < count; ++i) {
    auto const control = MakeCom<IAudioSessionControl>(
        [&](IAudioSessionControl** result) { return list->GetSession(i, result); });
    if (control) AppendIfOwn(*control, sessions);
  }
}

}  // namespace

std::vector<AudioSession> ListOwnAudioSessions() {
  std::vector<AudioSession> sessions;
  auto const devices = ListRenderDevices();
  UINT count = 0;
  if (!devices || FAILED(devices->GetCount(&count))) return sessions;
  for (UINT i = 0; i < count; ++i) {
    auto const device =
        MakeCom<IMMDevice>([&](IMMDevice** result) { return devices->Item(i, result); });
    if (device) AppendOwnSessions(*device, sessions);
  }
  return sessions;
}

}  // namespace Ostinet::Impl
