#pragma once

#include <libxml/xmlerror.h>

namespace dp {

// While it lives, libxml2 reports nothing through the thread's own two channels, which may be the
// host's; then those are as they were. Errors are told by results. Handlers of single readers do
// not suffice: files that cannot be opened and bytes that cannot be decoded are reported past them.
class SilentLibxml2 {
  public:
    SilentLibxml2()
        : handler_(xmlStructuredError),
          context_(xmlStructuredErrorContext),
          printer_(xmlGenericError),
          printerContext_(xmlGenericErrorContext) {
        xmlSetStructuredErrorFunc(nullptr, ignore);
        xmlSetGenericErrorFunc(nullptr, ignoreText);
    }
    ~SilentLibxml2() {
        xmlSetStructuredErrorFunc(context_, handler_);
        xmlSetGenericErrorFunc(printerContext_, printer_);
    }
    SilentLibxml2(const SilentLibxml2&) = delete;
    SilentLibxml2& operator=(const SilentLibxml2&) = delete;

    static void ignore(void*, xmlErrorPtr) {}

  private:
    static void ignoreText(void*, const char*, ...) {}

    xmlStructuredErrorFunc handler_;
    void* context_;
    xmlGenericErrorFunc printer_;
    void* printerContext_;
};

}  // namespace dp
