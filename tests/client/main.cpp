// SPDX-License-Identifier: MIT
// The smallest host: it signs in, prints one line for each destination, and signs out.
#include <iostream>

#include "ostinet/Endpoint.h"
#include "ostinet/Setup.h"

namespace {

/// What every host tells the library about itself.
class Callbacks : public Ostinet::OstinetCallbackAPI {
 public:
  double GetSampleTime(unsigned long long hostClocks) override {
    constexpr double kClocksPerSecond = 1e7;
    constexpr double kSamplesPerSecond = 48000;
    return static_cast<double>(hostClocks) / kClocksPerSecond * kSamplesPerSecond;
  }
  Ostinet::Provider<Ostinet::Impl::WinMIDIDevicesListener>* GetDevicesProvider() override {
    return &devices_;
  }

 private:
  Ostinet::Provider<Ostinet::Impl::WinMIDIDevicesListener> devices_;
};

/// This host listens to nothing.
class DeafReceiver : public Ostinet::Receiver {
 public:
  bool WantsPacket(Ostinet::DataPacket const&, Ostinet::Source const&) override { return false; }
  void HandlePacket(Ostinet::DataPacket const&, Ostinet::Source const&) override {}
};

}  // namespace

int main() {
  // Both outlive the studio, which is taken down when the program ends.
  static Callbacks callbacks;
  static DeafReceiver receiver;
  Ostinet::OstinetCallbackAPI::gInstance = &callbacks;

  Ostinet::Setup& setup = Ostinet::Setup::Instance();
  if (setup.SignIn("List of destinations", &receiver, nullptr) != Ostinet::Setup::kSignInOK) {
    std::cerr << "The MIDI system cannot be reached.\n";
    return 1;
  }
  for (int i = 0; i < setup.CountDestinations(); ++i) {
    std::cout << setup.GetDestination(i).GetName().string() << "\n";
  }
  setup.SignOut(false);
  return 0;
}
