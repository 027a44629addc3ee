#include "app/InstanceCalls.h"

#include <QTimer>
#include <algorithm>
#include <utility>

/// A call whose request has not arrived as a whole.
struct InstanceCalls::Caller : QObject {
  explicit Caller(InstanceCall call)
      : Call(std::move(call)), Readable(Call.Number(), QSocketNotifier::Read) {}

  InstanceCall Call;
  QSocketNotifier Readable;
  QTimer Patience;
};

InstanceCalls::InstanceCalls(int listener, std::function<bool()> mayTake,
                             std::function<void(const InstanceRequest& request)> take)
    : listener_(listener), mayTake_(std::move(mayTake)), take_(std::move(take)) {
  if (listener_ >= 0) {
    arriving_ = std::make_unique<QSocketNotifier>(listener_, QSocketNotifier::Read);
    connect(arriving_.get(), &QSocketNotifier::activated, this, [this] { Accept(); });
  }
}

InstanceCalls::~InstanceCalls() = default;

void InstanceCalls::Accept() {
  constexpr std::size_t mostCallers = 16;
  constexpr int pauseMilliseconds = 1000;
  constexpr int patienceMilliseconds = 3000;
  bool failed = false;
  std::optional<InstanceCall> call = InstanceCall::Accept(listener_, failed);
  if (failed) {  // the socket stays readable, which would keep the program busy
    arriving_->setEnabled(false);
    QTimer::singleShot(pauseMilliseconds, this, [this] { arriving_->setEnabled(true); });
  }
  if (!call) {
    return;
  }
  if (callers_.size() == mostCallers) {
    HangUp(*callers_.front());
  }
  Caller& caller = *callers_.emplace_back(std::make_unique<Caller>(std::move(*call)));
  connect(&caller.Readable, &QSocketNotifier::activated, this, [this, &caller] { Read(caller); });
  connect(&caller.Patience, &QTimer::timeout, this, [this, &caller] { HangUp(caller); });
  caller.Patience.setSingleShot(true);
  caller.Patience.start(patienceMilliseconds);
}

void InstanceCalls::Read(Caller& caller) {
  const InstanceCall::State state = caller.Call.Read();
  if (state == InstanceCall::State::Pending) {
    return;
  }
  const InstanceRequest request = caller.Call.Request();
  const bool isTaken = state == InstanceCall::State::Complete && mayTake_() && caller.Call.Answer();
  HangUp(caller);
  if (isTaken) {
    take_(request);
  }
}

void InstanceCalls::HangUp(const Caller& caller) {
  const auto found = std::find_if(callers_.begin(), callers_.end(),
                                  [&caller](const auto& each) { return each.get() == &caller; });
  // Its own notifier or timer may be what calls this.
  Caller* const gone = found->release();
  callers_.erase(found);
  gone->Readable.setEnabled(false);
  gone->Patience.stop();
  gone->deleteLater();
}
