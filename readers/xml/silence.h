#pragma once

#include <libxml/xmlerror.h>
#include <libxml/xmlversion.h>

namespace dp {

// The argument of error handlers, which is const since libxml2 2.12.
#if LIBXML_VERSION >= 21200
using XmlErrorPointer = const xmlError*;
#else
using XmlErrorPointer = xmlError*;
#endif

// During its lifetime libxml2 reports nothing to the thread's two error handlers, which may be the
// host's; they are restored afterwards. Callers learn of errors by results. Handlers of single
// readers do not suffice: errors in opening files and decoding bytes bypass them. Only a thread's
// outermost instance does anything: every node is read under one, and finding the handlers takes
// libxml2 long.
class SilentLibxml2 {
  public:
    SilentLibxml2() {
        if (depth_++ == 0) before_ = silence();
    }
    ~SilentLibxml2() {
        if (--depth_ == 0) restore(before_);
    }
    SilentLibxml2(const SilentLibxml2&) = delete;
    SilentLibxml2& operator=(const SilentLibxml2&) = delete;

    static void ignore(void*, XmlErrorPointer) {}

  private:
    struct Channels {
        xmlStructuredErrorFunc handler;
        void* context;
        xmlGenericErrorFunc printer;
        void* printerContext;
    };

    static void ignoreText(void*, const char*, ...) {}
    static Channels silence() {
        const Channels before{xmlStructuredError, xmlStructuredErrorContext, xmlGenericError,
                              xmlGenericErrorContext};
        xmlSetStructuredErrorFunc(nullptr, ignore);
        xmlSetGenericErrorFunc(nullptr, ignoreText);
        return before;
    }
    static void restore(const Channels& channels) {
        xmlSetStructuredErrorFunc(channels.context, channels.handler);
        xmlSetGenericErrorFunc(channels.printerContext, channels.printer);
    }

    static inline constinit thread_local unsigned depth_ = 0;
    Channels before_{};  // of the outermost
};

}  // namespace dp
