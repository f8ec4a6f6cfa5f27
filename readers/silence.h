#pragma once

#include <libxml/xmlerror.h>

namespace dp {

// While it lives, libxml2 reports nothing through the thread's own channel, which may be the
// host's; then that is as it was. Errors are told by results. Handlers of single readers do not
// suffice: files that cannot be opened and bytes that cannot be decoded are reported past them.
class SilentLibxml2 {
  public:
    SilentLibxml2() : handler_(xmlStructuredError), context_(xmlStructuredErrorContext) {
        xmlSetStructuredErrorFunc(nullptr, ignore);
    }
    ~SilentLibxml2() { xmlSetStructuredErrorFunc(context_, handler_); }
    SilentLibxml2(const SilentLibxml2&) = delete;
    SilentLibxml2& operator=(const SilentLibxml2&) = delete;

    static void ignore(void*, xmlErrorPtr) {}

  private:
    xmlStructuredErrorFunc handler_;
    void* context_;
};

}  // namespace dp
