// HttpTransport: the one HTTP exchange of HttpConfigurationClient, over libcurl. Every post starts
// from its thread's easy handle reset to its defaults (nothing carries over from the last post)
// and opens a connection of its own, which it closes after the answer: no connection is kept or
// taken up again, so a request is never sent twice. A post is routed by HttpRoute to the client's
// server, sends the cookies in key order in one Cookie header and an explicit Content-Length. The
// time-out bounds silence, not the whole exchange: connecting may take at most that long, and
// afterwards the exchange is ended only when no byte went up or came down for longer than that
// (checked about once a second), so a large body on a slow link is not cut while it still moves.
//
// TLS peers are verified against the system's certificate store, or against the PEM bundle named
// by the environment variable QUORVEX_CA_FILE when it is set (for private certificate
// authorities and tests); verification is never turned off.
//
// Each thread has its own handle; post() may be called from any number of threads at once.
#pragma once

#include <ace/SString.h>

#include <map>

namespace Configuration {

class HttpTransport {
public:
    enum class Outcome {
        Answered,     // a complete HTTP answer arrived (any status)
        NotSent,      // no connection, TLS failure, or the request could not be written
        NotReceived,  // sent, but no complete answer arrived in time
    };
    struct Answer {
        ACE_CString statusCode;  // decimal text, e.g. "200"
        ACE_CString body;
    };
    using CookieMap = std::map<ACE_CString, ACE_CString>;

    // Environment variable naming a CA bundle to verify TLS peers against.
    static constexpr const char* CA_FILE_VARIABLE = "QUORVEX_CA_FILE";

    // POSTs body to url over a new connection to server; fills answer when Answered.
    // timeoutMs is the longest silence allowed (0 or less: no limit).
    static Outcome post(const ACE_CString& server, const ACE_CString& url, const ACE_CString& body,
                        const CookieMap& cookies, long timeoutMs, Answer& answer);
};

}  // namespace Configuration
