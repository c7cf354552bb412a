// SPDX-License-Identifier: MIT
#include "Session.h"

#include <chrono>
#include <filesystem>

#include "Errors.h"
#include "Interrupt.h"
#include "Output.h"
#include "Studio.h"
#include "ostinet/core/XML.h"

namespace Ostinet::Tool {
namespace {

struct SignInFault {
  Setup::SignInResult result;
  char const* sentence;
};

constexpr char kStudioFile[] = "Ostinet.xml";

constexpr SignInFault kSignInFaults[] = {
    {Setup::kSignInAlreadySignedIn, "the MIDI system is in use already"},
    {Setup::kSignInPlatformError, "the MIDI system could not be started"},
    {Setup::kSignInNoMasterClock, "the MIDI system has no clock"},
    {Setup::kSignInCoarseMasterClock, "the clock of the MIDI system is coarser than a millisecond"},
};

std::string SignInSentence(Setup::SignInResult result) {
  for (SignInFault const& fault : kSignInFaults) {
    if (fault.result == result) {
      return fault.sentence;
    }
  }
  return "signing in to the MIDI system failed with result " + std::to_string(result);
}

Folder FolderAt(std::string const& path) {
  std::u8string const text(path.begin(), path.end());
  std::u16string const full = std::filesystem::absolute(std::filesystem::path(text)).u16string();
  return Folder(FileSpecification(UString(full)));
}

// A folder that the user named has to work. Without the user's own one the program still runs.
std::unique_ptr<FolderPrefs> OpenSettings(GlobalOptions const& options) {
  Folder const folder = SettingsFolder(options);
  if (!folder.IsValid()) {
    return nullptr;
  }
  auto prefs = std::make_unique<FolderPrefs>(folder);
  try {
    prefs->EnsureFolder();
  } catch (std::exception const& error) {
    std::string const sentence = "the settings folder \"" + folder.GetFullPath().string() +
                                 "\" cannot be written to: " + error.what();
    if (!options.settings.empty()) {
      throw Failure(sentence);
    }
    Notify(sentence + "; going on without settings");
    return nullptr;
  }
  return prefs;
}

// Why the studio in a file cannot be read to its end; empty where it can, or where there is none.
std::string FaultOf(File const& file) {
  try {
    if (!file.IsFile() || file.Read().empty()) {
      return "";
    }
    XMLLib::Parser parser(file);
    if (!parser.DownToChild("Ostinet")) {
      return "it is another kind of file";
    }
    parser.UpToParent();  // reads all of it
    return "";
  } catch (std::exception const& error) {
    return error.what();
  }
}

// Whether a save puts a new file in the place of the old one. The time of the old one tells, which
// is set back before: in places files are dated to the second, and a program may save twice in one.
class Replacement {
 public:
  explicit Replacement(File const& file)
      : path_(file.GetFullPath().utf16_str()), wasThere_(IsThere()), time_(Time()) {
    SetTime(time_ - std::chrono::hours(1));
    mark_ = Time();
  }
  Replacement(Replacement const&) = delete;
  Replacement& operator=(Replacement const&) = delete;
  // An old file that stays gets its time back.
  ~Replacement() {
    if (!IsDone()) {
      SetTime(time_);
    }
  }
  bool IsDone() const { return IsThere() && (!wasThere_ || Time() != mark_); }

 private:
  using FileTime = std::filesystem::file_time_type;

  bool IsThere() const {
    std::error_code error;
    return std::filesystem::is_regular_file(path_, error);
  }
  FileTime Time() const {
    std::error_code error;
    FileTime const time = std::filesystem::last_write_time(path_, error);
    return error ? FileTime() : time;
  }
  // Without the right to do so the file's own time has to tell.
  void SetTime(FileTime time) const {
    std::error_code ignored;
    if (wasThere_) {
      std::filesystem::last_write_time(path_, time, ignored);
    }
  }

  std::filesystem::path const path_;
  bool const wasThere_;
  FileTime const time_;
  FileTime mark_;
};

void NotifyError(std::exception_ptr const& error) {
  try {
    std::rethrow_exception(error);
  } catch (std::exception const& exception) {
    Notify(exception.what());
  } catch (...) {
    Notify("an unknown error");
  }
}

PollLoop::Options LoopOptions() {
  PollLoop::Options options;
  options.onError = NotifyError;
  return options;
}

// The library chooses its system at the first call, so the studio comes before all else.
std::unique_ptr<FolderPrefs> Prepare(GlobalOptions const& options) {
  ChooseStudio(options.studio);
  return OpenSettings(options);
}

}  // namespace

Folder SettingsFolder(GlobalOptions const& options) {
  std::string const& path = options.settings;
  return path.empty() ? FolderPrefs::UserFolder("Ostinet") : FolderAt(path);
}

Session::Session(GlobalOptions const& options, Receiver* receiver, SetupListener* listener)
    : prefs_(Prepare(options)), loop_(LoopOptions()), callbacks_([this] { loop_.Hurry(); }) {
  std::string const why = WhyNoMIDI(options.studio);
  if (!why.empty()) {
    Notify(why);
  }
  if (prefs_ != nullptr) {
    virtualEndpoints_.Load(FileInSettings(kVirtualEndpointsFile));
    LookForDamage();
  }
  SignIn(receiver, listener);
}

// The library reads up to the damage and says nothing of it; to save that much only would lose the
// rest for good.
void Session::LookForDamage() {
  File const file = FileInSettings(kStudioFile);
  std::string const fault = FaultOf(file);
  if (!fault.empty()) {
    damage_ =
        "the studio in \"" + file.GetFullPath().string() + "\" cannot be read to its end: " + fault;
    Notify(damage_);
  }
}

void Session::SignIn(Receiver* receiver, SetupListener* listener) {
  Setup& setup = GetSetup();
  Setup::SignInResult const result = setup.SignIn("ostinet", receiver, prefs_.get());
  if (result != Setup::kSignInOK) {
    setup.SignOut(false);
    throw Failure(SignInSentence(result));
  }
  setup.SetListener(listener);
  virtualEndpoints_.Make(setup);
}

File Session::FileInSettings(char const* name) const {
  Folder folder;
  prefs_->GetFolder(folder);
  return folder.GetFile(UString(name));
}

void Session::Save() {
  if (prefs_ == nullptr) {
    throw Failure(
        "there is no folder for settings to keep this in: name one with --settings FOLDER");
  }
  if (!damage_.empty()) {
    throw Failure("nothing is saved over a studio that cannot be read: mend or remove the file");
  }
  Replacement const replacement(FileInSettings(kStudioFile));
  GetSetup().SetListener(nullptr);
  GetSetup().SignOut(true);
  FailIfSettingsFailed();
  // The library saves without a word, so what it left behind has to tell.
  if (!replacement.IsDone()) {
    throw Failure("the studio could not be saved in \"" +
                  FileInSettings(kStudioFile).GetFullPath().string() + "\"; it is as it was");
  }
  virtualEndpoints_.Save(FileInSettings(kVirtualEndpointsFile));
}

std::string Session::SettingsFault() const {
  return prefs_ != nullptr ? prefs_->LastError() : std::string();
}

void Session::FailIfSettingsFailed() const {
  if (!SettingsFault().empty()) {
    throw Failure("settings could not be kept: " + SettingsFault());
  }
}

Session::~Session() {
  bool const wasSignedIn = GetSetup().IsSignedIn();
  try {
    GetSetup().SetListener(nullptr);
    GetSetup().SignOut(false);
  } catch (std::exception const& error) {
    Notify(error.what());
  }
  if (wasSignedIn && !SettingsFault().empty()) {
    Notify("settings could not be kept: " + SettingsFault());
  }
}

void Session::Run(std::function<bool()> const& goOn) {
  loop_.Run([&] { return !IsInterrupted() && goOn(); });
}

void Session::RunFor(PollLoop::Duration duration) {
  auto const end = PollLoop::Clock::now() + duration;
  Run([&] { return PollLoop::Clock::now() < end; });
}

bool Limits::AreReached(PollLoop::Clock::time_point start, long long printed) const {
  std::chrono::duration<double> const passed = PollLoop::Clock::now() - start;
  return (seconds && passed.count() >= *seconds) || (count && printed >= *count);
}

}  // namespace Ostinet::Tool
