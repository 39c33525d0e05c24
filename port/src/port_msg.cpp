// Reporting: report objects, dispatcher, console manager, message stream, capture.
#include <algorithm>
#include <cstdarg>
#include <cstdio>

#include "port/port.h"
#include "port/port_testing.h"

namespace {

std::string vformat(const char* fmt, va_list ap) {
  va_list copy;
  va_copy(copy, ap);
  char small[512];
  int n = vsnprintf(small, sizeof small, fmt, copy);
  va_end(copy);
  if (n < 0) return std::string();
  if (static_cast<size_t>(n) < sizeof small) return std::string(small, n);
  std::string text(static_cast<size_t>(n) + 1, '\0');
  va_copy(copy, ap);
  vsnprintf(&text[0], text.size(), fmt, copy);
  va_end(copy);
  text.resize(n);
  return text;
}

// The manager in place when the process starts: every report to the console.
class ConsoleMan : public Port_MsgMan {
 public:
  void receive(const Port_Report& report) override {
    Port::File::getCout()->write(Port_FormatReport(report));
  }
};

struct DispatchState {
  ConsoleMan console;
  std::vector<Port_MsgMan*> managers{&console};
  std::vector<PortTest::Capture*> captures;
  int lineWidth = 80;
};

DispatchState& state() {
  static DispatchState* s = new DispatchState;  // lives until process exit
  return *s;
}

Port_Report makeReport(Port_MsgLevel level, const char* module, const char* unit, int line,
                       const char* revision, const char* fmt, va_list ap) {
  return Port_Report{level, module ? module : "", unit ? unit : "", line,
                     revision ? revision : "", vformat(fmt, ap)};
}

void recordCaptures(const Port_Report& report) {
  for (PortTest::Capture* c : state().captures) c->record(report);
}

}  // namespace

std::string Port_FormatReport(const Port_Report& report) {
  switch (report.level) {
    case Port_Status: return report.text;
    case Port_Warning: return "WARNING:" + report.module + " - " + report.text;
    case Port_Error: return "ERROR:" + report.module + " - " + report.text;
    case Port_Fatal: return "FATAL_ERROR:" + report.module + " - " + report.text;
  }
  return report.text;
}

// ---- report object ----

Port_MsgManData* Port_MsgManData::createObject(const char* module, const char* unit, int line,
                                               const char* revision) {
  static Port_MsgManData* object = new Port_MsgManData;  // one object, reused for every report
  object->module_ = module ? module : "";
  object->unit_ = unit ? unit : "";
  object->line_ = line;
  object->revision_ = revision ? revision : "";
  return object;
}

void Port_MsgManData::issue(Port_MsgLevel level, const char* fmt, va_list ap) {
  Port_MsgDispatcher::dispatch(
      makeReport(level, module_.c_str(), unit_.c_str(), line_, revision_.c_str(), fmt, ap));
}

#define PORT_ISSUE(level)   \
  va_list ap;               \
  va_start(ap, fmt);        \
  issue(level, fmt, ap);    \
  va_end(ap)

void Port_MsgManData::issueStatus(const char* fmt, ...) { PORT_ISSUE(Port_Status); }
void Port_MsgManData::issueWarning(const char* fmt, ...) { PORT_ISSUE(Port_Warning); }
void Port_MsgManData::issueError(const char* fmt, ...) { PORT_ISSUE(Port_Error); }
void Port_MsgManData::issueFatal(int, const char* fmt, ...) { PORT_ISSUE(Port_Fatal); }

// ---- dispatcher ----

Port_MsgMan* Port_MsgDispatcher::getDefaultMsgMan() {
  auto& m = state().managers;
  return m.empty() ? nullptr : m.front();
}

void Port_MsgDispatcher::addMsgMan(Port_MsgMan* man) {
  auto& m = state().managers;
  if (man && std::find(m.begin(), m.end(), man) == m.end()) m.push_back(man);
}

void Port_MsgDispatcher::removeMsgMan(Port_MsgMan* man) {
  auto& m = state().managers;
  m.erase(std::remove(m.begin(), m.end(), man), m.end());
}

void Port_MsgDispatcher::setMaxLineWidth(int width) { state().lineWidth = width; }
int Port_MsgDispatcher::getMaxLineWidth() { return state().lineWidth; }

void Port_MsgDispatcher::dispatch(const Port_Report& report) {
  recordCaptures(report);
  // A manager may remove itself while receiving: walk a copy.
  std::vector<Port_MsgMan*> managers = state().managers;
  for (Port_MsgMan* man : managers) man->receive(report);
}

// ---- message stream ----

Port_MsgStream::Port_MsgStream(const char*) {}
Port_MsgStream::~Port_MsgStream() { Port_MsgDispatcher::removeMsgMan(this); }

Port_MsgStream::Output* Port_MsgStream::find(Port::Stream* stream) {
  for (Output& o : outputs_)
    if (o.stream == stream) return &o;
  return nullptr;
}

const Port_MsgStream::Output* Port_MsgStream::find(Port::Stream* stream) const {
  return const_cast<Port_MsgStream*>(this)->find(stream);
}

void Port_MsgStream::addStream(Port::Stream* stream) {
  if (stream && !find(stream)) outputs_.push_back(Output{stream, 0x1FFu});
}

void Port_MsgStream::removeStream(Port::Stream* stream) {
  outputs_.erase(std::remove_if(outputs_.begin(), outputs_.end(),
                                [stream](const Output& o) { return o.stream == stream; }),
                 outputs_.end());
}

void Port_MsgStream::enableMsgType(Port::Stream* stream, int type) {
  Output* o = find(stream);
  if (o && type >= 0 && type <= 8) o->typeMask |= 1u << type;
}

void Port_MsgStream::disableMsgType(Port::Stream* stream, int type) {
  Output* o = find(stream);
  if (o && type >= 0 && type <= 8) o->typeMask &= ~(1u << type);
}

bool Port_MsgStream::isAttached(Port::Stream* stream) const { return find(stream) != nullptr; }

bool Port_MsgStream::isMsgTypeEnabled(Port::Stream* stream, int type) const {
  const Output* o = find(stream);
  return o && type >= 0 && type <= 8 && (o->typeMask >> type & 1u);
}

std::vector<Port::Stream*> Port_MsgStream::attachedStreams() const {
  std::vector<Port::Stream*> streams;
  for (const Output& o : outputs_) streams.push_back(o.stream);
  return streams;
}

void Port_MsgStream::receive(const Port_Report& report) {
  std::string text = Port_FormatReport(report);
  for (const Output& o : outputs_)
    if (o.typeMask >> report.level & 1u) o.stream->write(text);
}

void Port_MsgStream::deliver(Port_MsgLevel level, const char* module, const char* unit, int line,
                             const char* revision, const char* fmt, va_list ap) {
  Port_Report report = makeReport(level, module, unit, line, revision, fmt, ap);
  recordCaptures(report);
  receive(report);
}

void Port_MsgStream::issueStatusV(const char* module, const char* unit, int line,
                                  const char* revision, const char* fmt, va_list ap) {
  deliver(Port_Status, module, unit, line, revision, fmt, ap);
}

void Port_MsgStream::issueWarningV(const char* module, const char* unit, int line,
                                   const char* revision, const char* fmt, va_list ap) {
  deliver(Port_Warning, module, unit, line, revision, fmt, ap);
}

// ---- capture ----

namespace PortTest {

Capture::Capture() { state().captures.push_back(this); }

Capture::~Capture() {
  auto& c = state().captures;
  c.erase(std::remove(c.begin(), c.end(), this), c.end());
}

std::string Capture::text(int level) const {
  std::string all;
  for (const Port_Report& r : reports_)
    if (level < 0 || r.level == level) all += r.text;
  return all;
}

}  // namespace PortTest
