// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <functional>
#include <memory>
#include <vector>

#include "ostinet/Autodetect.h"
#include "ostinet/Endpoint.h"
#include "ostinet/core/Noncopyable.h"

namespace Ostinet {

/// Finds out which instruments answer on which ports: asks the ports one after the other, request
/// by request, and reads what comes back.
///
/// The host calls Step every few milliseconds beside its polls. Each request's messages go out no
/// faster than a MIDI cable carries them, then its answers are waited for as long as the request
/// says. Answers may come in pieces, from several instruments, through any of the sources, and
/// late: they are taken until the next port has its turn. What comes back as it was sent, through a
/// loop in the studio, counts for nothing.
///
/// While it runs, the sources it listens to hand their input to it alone; in the end they get back
/// the receivers that they had. Input comes as far as the receiver given at sign-in wants it, so
/// that one has to want sysex.
///
/// Ownership    The host's. It keeps handles, so ports may come and go meanwhile.
/// Threads      The host's polling thread; WantsPacket [any thread].
/// Errors       Step throws where the system cannot tell the time; the run is then to be cancelled.
class DetectionRun final : public Receiver, private Noncopyable<DetectionRun> {
 public:
  using Bytes = std::vector<unsigned char>;

  static constexpr int kNoDeviceID = -1;
  /// What an instrument gives for its ID that has none, or hears all.
  static constexpr int kAllDeviceIDs = 127;
  /// So much of each reply is kept.
  static constexpr std::size_t kMostReplyBytes = 512;

  /// An instrument that answered.
  struct Finding {
    /// Where its answer came in.
    Source source;
    /// 0 to 127 as it goes over the wire, or kNoDeviceID where no answer told it.
    int deviceID = kNoDeviceID;
    /// What it can be, the likeliest first. Empty for an identity that belongs to no type.
    std::vector<DeviceTypeInfo> types;
    /// From its answer to the universal inquiry: the bytes of maker, family and member. Empty
    /// where it gave none.
    Bytes identity;
    /// The first answer.
    Bytes reply;
  };

  enum class Outcome {
    kWaiting,    ///< not asked yet
    kAsking,     ///< being asked now
    kDone,       ///< asked everything
    kTimeLimit,  ///< the time for one port was over before that
    kOffline,    ///< cannot be reached, or went away
    kCancelled,  ///< Cancel came before or meanwhile
  };

  struct Port {
    Destination destination;
    Outcome outcome = Outcome::kWaiting;
    std::vector<Finding> findings;
  };

  struct Progress {
    std::size_t port = 0;  ///< the index of the port that is being asked
    std::size_t ports = 0;
    std::size_t request = 0;  ///< how many of its requests are done
    std::size_t requests = 0;
    double fraction = 0.0;  ///< of the whole run, 0 to 1
  };

  struct Options {
    /// What to ask, in this order; those of the catalog where there are none.
    std::vector<Autodetect::Request> requests;
    /// At most so many seconds for each port; 0 for as many as it takes.
    double portTimeLimit = 0.0;
    /// So many seconds a port is listened to after its last request, for answers that come late.
    double lateAnswers = 1.0;
    /// The seconds that a byte takes: those of a MIDI cable. At 0 a request goes out at once.
    double secondsPerByte = 0.00032;
    /// Puts the universal inquiry to all device IDs at once, beside those that the catalog names.
    bool inquireOfAll = true;
    /// Called in Step whenever GetProgress gives something new.
    std::function<void()> onProgress;
  };

  /// Asks `destinations` in this order and listens to `sources`.
  DetectionRun(std::vector<Destination> const& destinations, std::vector<Source> const& sources,
               Options options);
  /// The same with the default options.
  DetectionRun(std::vector<Destination> const& destinations, std::vector<Source> const& sources);
  /// Cancels.
  ~DetectionRun();

  /// The ports of Setup::Instance that can be asked and listened to now, without those of
  /// `excluded`: destinations and sources alike.
  static std::vector<Destination> DestinationsToAsk(std::vector<Endpoint> const& excluded = {});
  static std::vector<Source> SourcesToHear(std::vector<Endpoint> const& excluded = {});

  /// Does what is due. False when the run has ended. The first call begins it.
  bool Step();
  /// Ends the run; what was found stays.
  void Cancel();
  bool IsDone() const;

  /// The ports in the order of the constructor, with what was found until now.
  std::vector<Port> const& Ports() const;
  Progress GetProgress() const;

  /// Whether a packet is sysex or a piece of it: what a run has to hear. [any thread]
  static bool IsSysex(DataPacket const& packet);

  /// For input that reaches the run by another way than its sources.
  bool WantsPacket(DataPacket const& packet, Source const& source) override;
  void HandlePacket(DataPacket const& packet, Source const& source) override;

 private:
  class Impl;

  std::unique_ptr<Impl> impl_;
};

}  // namespace Ostinet
