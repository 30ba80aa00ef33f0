#include "platform/feeds/http/HttpStatus.h"

#include <algorithm>
#include <array>

namespace orvo {

namespace {

struct Meaning {
    int status;
    const char* words;
};

constexpr std::array Meanings = {
    Meaning{204, "No Content"},
    Meaning{206, "Partial Content"},
    Meaning{301, "Moved Permanently"},
    Meaning{302, "Found"},
    Meaning{303, "See Other"},
    Meaning{304, "Not Modified"},
    Meaning{307, "Temporary Redirect"},
    Meaning{308, "Permanent Redirect"},
    Meaning{400, "Bad Request"},
    Meaning{401, "Unauthorized"},
    Meaning{402, "Payment Required"},
    Meaning{403, "Forbidden"},
    Meaning{404, "Not Found"},
    Meaning{405, "Method Not Allowed"},
    Meaning{406, "Not Acceptable"},
    Meaning{407, "Proxy Authentication Required"},
    Meaning{408, "Request Timeout"},
    Meaning{410, "Gone"},
    Meaning{412, "Precondition Failed"},
    Meaning{413, "Content Too Large"},
    Meaning{414, "URI Too Long"},
    Meaning{418, "I'm a teapot"},
    Meaning{421, "Misdirected Request"},
    Meaning{425, "Too Early"},
    Meaning{426, "Upgrade Required"},
    Meaning{429, "Too Many Requests"},
    Meaning{431, "Request Header Fields Too Large"},
    Meaning{451, "Unavailable For Legal Reasons"},
    Meaning{500, "Internal Server Error"},
    Meaning{501, "Not Implemented"},
    Meaning{502, "Bad Gateway"},
    Meaning{503, "Service Unavailable"},
    Meaning{504, "Gateway Timeout"},
    Meaning{505, "HTTP Version Not Supported"},
    Meaning{507, "Insufficient Storage"},
    Meaning{511, "Network Authentication Required"},
};

} // namespace

std::string describeHttpStatus(int status) {
    const auto found = std::ranges::find(Meanings, status, &Meaning::status);
    const auto number = std::to_string(status);
    return found == Meanings.end() ? number : number + " " + found->words;
}

} // namespace orvo
