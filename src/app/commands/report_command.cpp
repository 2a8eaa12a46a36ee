#include "app/commands/report_command.h"

#include <cerrno>
#include <fcntl.h>
#include <system_error>
#include <unistd.h>

#include "app/commands/row_readings.h"
#include "app/program/vesk_interface.h"
#include "app/source/watched_drive.h"
#include "system/file_descriptor.h"
#include "web/report_page.h"

namespace vesk {

namespace {

/// Where the page is written: a file or standard output. The user is told, once, when it fails.
class PageOutput {
 public:
  explicit PageOutput(const std::optional<std::string>& path) : name_(path.value_or("standard output")) {
    constexpr mode_t kMode = 0666;
    if (!path) return;
    file_ = FileDescriptor(open(path->c_str(), O_WRONLY | O_CREAT | O_CLOEXEC, kMode));
    if (!file_.isOpen()) fail();
    descriptor_ = file_.get();
  }

  /// What a file held stays until there is something to take its place.
  void begin() const {
    // A device or a pipe cannot be cut, and needs not be.
    [[maybe_unused]] const int result = file_.isOpen() ? ftruncate(descriptor_, 0) : 0;
  }
  void write(std::string_view piece) {
    while (!piece.empty() && !hasFailed_) {
      const ssize_t written = ::write(descriptor_, piece.data(), piece.size());
      if (written >= 0) {
        piece.remove_prefix(static_cast<std::size_t>(written));
      } else if (errno != EINTR) {
        fail();
      }
    }
  }
  [[nodiscard]] bool hasFailed() const { return hasFailed_; }

 private:
  void fail() {
    hasFailed_ = true;
    tellUser("vesk: " + name_ + ": " + std::generic_category().message(errno));
  }

  std::string name_;
  FileDescriptor file_;
  int descriptor_ = STDOUT_FILENO;
  bool hasFailed_ = false;
};

std::string titleOf(const RecordingInput& input) {
  if (input.path == "-") return "standard input";
  return input.path->substr(input.path->rfind('/') + 1);
}

}  // namespace

Outcome runReport(const ReportOptions& options) {
  PageOutput page(options.output);
  if (page.hasFailed()) return Outcome::failed;
  DataOutput unused;
  insight::Insight insight;
  web::DriveRecord record(web::kWholeDrive);
  insight.setStepHandler([&](const insight::Report& report, const std::vector<insight::TimelineEvent>& events) {
    record.take(insight, report, events);
  });
  const Outcome outcome = watchDrive(options.input, insight, unused, [&] {
    page.begin();
    web::writeReport({titleOf(options.input), record, insight, veskInterface(), readingOfRow},
                     [&](std::string_view piece) { page.write(piece); });
  });
  return page.hasFailed() ? Outcome::failed : outcome;
}

}  // namespace vesk
