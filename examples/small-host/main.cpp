// SPDX-License-Identifier: MIT
//
// A complete small host: it signs in, lists the studio, plays a note on an output, and prints what
// arrives within a second.
//
//   small_host [OUTPUT [SETTINGS-FOLDER]]
//
// Without an output it takes the first that is online. It runs on the machine's ports, or on the
// simulated studio that the environment variable OSTINET_STUDIO names.
#include <chrono>
#include <cstdio>
#include <exception>
#include <string>
#include <vector>

#include "ostinet/Setup.h"
#include "ostinet/TimeStamp.h"
#include "ostinet/hostkit/FolderPrefs.h"
#include "ostinet/hostkit/HostCallbacks.h"
#include "ostinet/hostkit/PollLoop.h"

namespace {

using namespace Ostinet;

// Takes all input. WantsPacket runs on the system's threads and must be quick; HandlePacket runs
// on the polling thread.
class Input : public Receiver {
 public:
  bool WantsPacket(DataPacket const&, Source const&) override { return true; }
  void HandlePacket(DataPacket const& packet, Source const& source) override {
    std::printf("received from %s:", source.GetName().string().c_str());
    for (unsigned long long i = 0; i < packet.length; ++i) {
      std::printf(" %02x", static_cast<unsigned>(packet.data[i]));
    }
    std::printf("\n");
  }
};

// Hears of every change. Whoever holds senders drops them on SetupChanged and makes new ones.
class Listener : public SetupListener {
 public:
  void SetupChanged() override { std::printf("the studio changed\n"); }
  void CurrentPatchChanged(Destination destination, unsigned short) override {
    std::printf("another patch plays on %s\n", destination.GetName().string().c_str());
  }
  void DestinationNamesChanged(Destination, unsigned short) override {}
};

// Ends the session whichever way the program goes.
struct SignedIn {
  ~SignedIn() {
    Setup::Instance().SignOut(true);  // keeps the studio for the next time
    Setup::Instance().SetListener(nullptr);
  }
};

void Print(char const* kind, Endpoint const& endpoint) {
  std::printf("%-7s %s%s\n", kind, endpoint.GetName().string().c_str(),
              endpoint.IsOnline() ? "" : " (offline)");
}

void List(Setup const& setup) {
  for (int i = 0; i < setup.CountDestinations(); ++i) {
    Print("output", setup.GetDestination(i));
  }
  for (int i = 0; i < setup.CountSources(); ++i) {
    Print("input", setup.GetSource(i));
  }
}

Destination FindOutput(Setup const& setup, std::string const& name) {
  for (int i = 0; i < setup.CountDestinations(); ++i) {
    Destination const destination = setup.GetDestination(i);
    bool const isMeant = name.empty() || destination.GetName().string() == name;
    if (isMeant && destination.IsOnline()) {
      return destination;
    }
  }
  return Destination();
}

void PlayNote(Destination const& destination) {
  std::vector<unsigned char> const on = {0x90, 60, 100};
  std::vector<unsigned char> const off = {0x80, 60, 64};
  // A clock is 100 ns; the note ends a quarter of a second from now.
  Clocks const end(CurrentMIDITime().Value() + 2500000);
  std::unique_ptr<Impl::Sender> const sender = destination.MakeSender();
  if (sender != nullptr && sender->CanSend()) {
    sender->Send({on.data(), on.size(), kNoTimeStamp});  // now
    sender->Send({off.data(), off.size(), TimeStamp(end)});
    sender->Flush();
  }
}

int Run(std::string const& output, Folder const& settings) {
  PollLoop loop;
  HostCallbacks const callbacks([&loop] { loop.Hurry(); });  // before the first Setup::Instance
  FolderPrefs prefs(settings);
  Input input;
  Listener listener;

  Setup& setup = Setup::Instance();
  if (setup.SignIn("Small host", &input, &prefs) != Setup::kSignInOK) {
    std::fprintf(stderr, "the MIDI system could not be started\n");
    setup.SignOut(false);
    return 1;
  }
  SignedIn const signedIn;
  setup.SetListener(&listener);
  List(setup);

  Destination const destination = FindOutput(setup, output);
  if (!destination.Exists()) {
    std::fprintf(stderr, "there is no output %s that is online\n", output.c_str());
    return 1;
  }
  PlayNote(destination);
  auto const end = std::chrono::steady_clock::now() + std::chrono::seconds(1);
  loop.Run([end] { return std::chrono::steady_clock::now() < end; });
  return 0;
}

}  // namespace

int main(int argc, char** argv) {
  try {
    Folder const settings = argc > 2 ? Folder(FileSpecification(UString(argv[2])))
                                     : FolderPrefs::UserFolder("Ostinet small host");
    return Run(argc > 1 ? argv[1] : "", settings);
  } catch (std::exception const& error) {
    std::fprintf(stderr, "%s\n", error.what());
    return 1;
  }
}
