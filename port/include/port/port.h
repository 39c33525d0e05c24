// Portability services: the small stand-in for the tool chain's support library.
// It provides reporting (report objects, dispatcher, message managers and the
// message stream), file streams, environment lookup, memory statistics, a string
// class, the vzl_* allocator and the per-unit initialiser classes.
//
// Message types. Each report level is carried as one message type:
//   0 fatal, 1 warning, 2 status, 4 error.
// Types 3, 5, 6, 7 and 8 are accepted by the per-output switches but no level
// of this stand-in produces them.
#pragma once

#include <cstdarg>
#include <cstddef>
#include <cstdio>
#include <string>
#include <vector>

#define PORT_API __attribute__((visibility("default")))

enum Port_MsgLevel { Port_Fatal = 0, Port_Warning = 1, Port_Status = 2, Port_Error = 4 };

// One report as seen by a message manager: origin and fully formatted text.
struct Port_Report {
  Port_MsgLevel level;
  std::string module;
  std::string unit;
  int line;
  std::string revision;
  std::string text;
};

namespace Port {

// An output that a message stream writes to: the console or an opened file.
class PORT_API Stream {
 public:
  explicit Stream(FILE* fp) : fp_(fp) {}
  void write(const std::string& text);
  FILE* handle() const { return fp_; }

 private:
  FILE* fp_;
};

class PORT_API File {
 public:
  // Access 2 creates or truncates the file, 6 appends to it; null on failure.
  static Stream* open(const char* path, int access, bool binary);
  static void close(Stream* stream);
  static Stream* getCout();
};

template <class C>
class StringBase {
 public:
  StringBase() = default;
  StringBase(const C* s) : s_(s ? s : "") {}
  const C* c_str() const { return s_.c_str(); }
  size_t length() const { return s_.size(); }
  bool operator==(const StringBase& o) const { return s_ == o.s_; }
  bool operator!=(const StringBase& o) const { return s_ != o.s_; }

 private:
  std::basic_string<C> s_;
};

// Initialiser classes: one static object of each per source unit.
class PORT_API FileInit { public: FileInit(); ~FileInit(); };
class PORT_API PathListInit { public: PathListInit(); ~PathListInit(); };

}  // namespace Port

class PORT_API InstanceTableInit { public: InstanceTableInit(); ~InstanceTableInit(); };
class PORT_API FactoryInit { public: FactoryInit(); ~FactoryInit(); };
class PORT_API Port_MsgManInit { public: Port_MsgManInit(); ~Port_MsgManInit(); };

// A receiver of reports. The dispatcher hands every report to each added manager.
class PORT_API Port_MsgMan {
 public:
  virtual ~Port_MsgMan() = default;
  virtual void receive(const Port_Report& report) = 0;
};

// The report object: made by createObject, then exactly one issue call.
class PORT_API Port_MsgManData {
 public:
  static Port_MsgManData* createObject(const char* module, const char* unit, int line,
                                       const char* revision);
  void issueStatus(const char* fmt, ...) __attribute__((format(printf, 2, 3)));
  void issueWarning(const char* fmt, ...) __attribute__((format(printf, 2, 3)));
  void issueError(const char* fmt, ...) __attribute__((format(printf, 2, 3)));
  void issueFatal(int severity, const char* fmt, ...) __attribute__((format(printf, 3, 4)));

 private:
  void issue(Port_MsgLevel level, const char* fmt, va_list ap);
  std::string module_, unit_, revision_;
  int line_ = 0;
};

class PORT_API Port_MsgDispatcher {
 public:
  static Port_MsgMan* getDefaultMsgMan();
  static void addMsgMan(Port_MsgMan* man);
  static void removeMsgMan(Port_MsgMan* man);
  static void setMaxLineWidth(int width);
  static int getMaxLineWidth();
  // Delivers a finished report to every capture and every added manager.
  static void dispatch(const Port_Report& report);
};

// A message manager writing to attached outputs, with a switch per output and type.
class PORT_API Port_MsgStream : public Port_MsgMan {
 public:
  explicit Port_MsgStream(const char* name);
  ~Port_MsgStream() override;
  virtual void issueStatusV(const char* module, const char* unit, int line, const char* revision,
                            const char* fmt, va_list ap);
  virtual void issueWarningV(const char* module, const char* unit, int line,
                             const char* revision, const char* fmt, va_list ap);
  virtual void addStream(Port::Stream* stream);
  virtual void removeStream(Port::Stream* stream);
  virtual void enableMsgType(Port::Stream* stream, int type);
  virtual void disableMsgType(Port::Stream* stream, int type);

  void receive(const Port_Report& report) override;
  // Test view: whether the output is attached, whether a type reaches it, and
  // the attached outputs in the order they were added.
  bool isAttached(Port::Stream* stream) const;
  bool isMsgTypeEnabled(Port::Stream* stream, int type) const;
  std::vector<Port::Stream*> attachedStreams() const;

 private:
  struct Output {
    Port::Stream* stream;
    unsigned typeMask;
  };
  Output* find(Port::Stream* stream);
  const Output* find(Port::Stream* stream) const;
  void deliver(Port_MsgLevel level, const char* module, const char* unit, int line,
               const char* revision, const char* fmt, va_list ap);
  std::vector<Output> outputs_;
};

class PORT_API Port_Env {
 public:
  static const char* GetEnv(const char* name);
};

class PORT_API UT_MEMORY {
 public:
  // Resident memory of the process in bytes.
  static unsigned getMemoryUsage();
};

extern "C" {
PORT_API void* vzl_malloc(size_t size);
PORT_API void* vzl_calloc(size_t count, size_t size);
PORT_API void* vzl_realloc(void* block, size_t size);
PORT_API void vzl_free(void* block);
}

// The text a message output shows for a report: status text as is, other
// levels behind their level name.
PORT_API std::string Port_FormatReport(const Port_Report& report);
