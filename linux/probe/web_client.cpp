#include "linux/probe/web_client.h"

#include <curl/curl.h>

#include <algorithm>
#include <ctime>
#include <memory>

#include "linux/wait_any.h"
#include "service/plain_text.h"

namespace wp {
namespace {

struct LibraryUser {
    LibraryUser() { curl_global_init(CURL_GLOBAL_DEFAULT); }
};

struct Release {
    void operator()(CURL* easy) const { curl_easy_cleanup(easy); }
    void operator()(curl_slist* list) const { curl_slist_free_all(list); }
    void operator()(CURLU* url) const { curl_url_cleanup(url); }
};
struct ReleaseMulti {
    void operator()(CURLM* multi) const { curl_multi_cleanup(multi); }
};
using Easy = std::unique_ptr<CURL, Release>;
using Multi = std::unique_ptr<CURLM, ReleaseMulti>;
using List = std::unique_ptr<curl_slist, Release>;

struct Part {
    CURLUPart part;
    unsigned flags = 0;
};

std::string partOf(const std::string& url, Part wanted) {
    const std::unique_ptr<CURLU, Release> parsed(curl_url());
    char* text = nullptr;
    if (!parsed || curl_url_set(parsed.get(), CURLUPART_URL, url.c_str(), 0) != CURLUE_OK) return {};
    if (curl_url_get(parsed.get(), wanted.part, &text, wanted.flags) != CURLUE_OK) return {};
    const std::unique_ptr<char, decltype(&curl_free)> owner(text, curl_free);
    return text;
}

/// OpenSSL's numbers of what is wrong with a certificate. The library checks the host's name first, and leaves the
/// number as it was before it looked at anything else.
CertificateFault faultOfCode(long code) {
    switch (code) {
        case 0:
        case 1:
        case 62:
            return CertificateFault::wrongHost;
        case 9:
            return CertificateFault::notYetValid;
        case 10:
            return CertificateFault::expired;
        case 18:
        case 19:
            return CertificateFault::selfSigned;
        case 2:
        case 20:
        case 21:
            return CertificateFault::unknownIssuer;
        case 23:
            return CertificateFault::revoked;
        default:
            return CertificateFault::other;
    }
}

/// One request under way.
class Transfer {
  public:
    explicit Transfer(const WebRequest& request) : request_(request), easy_(curl_easy_init()) {
        set(CURLOPT_URL, request.url.c_str());
        set(CURLOPT_PROTOCOLS_STR, "http,https");
        set(CURLOPT_NOPROXY, "*");
        set(CURLOPT_NOSIGNAL, 1L);
        set(CURLOPT_FRESH_CONNECT, 1L);
        set(CURLOPT_FORBID_REUSE, 1L);
        set(CURLOPT_HAPPY_EYEBALLS_TIMEOUT_MS, 250L);  // RFC 8305
        set(CURLOPT_HTTP_VERSION, static_cast<long>(CURL_HTTP_VERSION_1_1));
        set(CURLOPT_USERAGENT, "wifi-profile");
        setAuthorities();
        if (!request.interfaceName.empty()) set(CURLOPT_INTERFACE, ("if!" + request.interfaceName).c_str());
        if (request.connectOnly) set(CURLOPT_CONNECT_ONLY, 1L);
        if (request.post) {
            set(CURLOPT_POSTFIELDSIZE, static_cast<long>(request.post->size()));
            set(CURLOPT_COPYPOSTFIELDS, request.post->c_str());
        }
        for (const std::string& header : request.headers) append(headers_, header);
        set(CURLOPT_HTTPHEADER, headers_.get());
        setAddresses();
        set(CURLOPT_WRITEDATA, this);
        curl_easy_setopt(easy_.get(), CURLOPT_WRITEFUNCTION, &Transfer::take);
    }
    Transfer(const Transfer&) = delete;

    CURL* handle() const { return easy_.get(); }

    WebAnswer answer(CURLcode code) const {
        WebAnswer answer;
        long status = 0;
        curl_off_t microseconds = 0;
        curl_easy_getinfo(easy_.get(), CURLINFO_RESPONSE_CODE, &status);
        curl_easy_getinfo(easy_.get(), CURLINFO_TOTAL_TIME_T, &microseconds);
        answer.status = static_cast<int>(status);
        answer.body = body_;
        answer.location = info(CURLINFO_REDIRECT_URL);
        answer.contentType = info(CURLINFO_CONTENT_TYPE);
        answer.server = IPAddress::fromText(info(CURLINFO_PRIMARY_IP));
        answer.took = std::chrono::milliseconds(microseconds / 1000);
        // A body that is too long, or breaks off, comes after an answer all the same.
        const bool answered = code == CURLE_OK || (status != 0 && code != CURLE_PEER_FAILED_VERIFICATION);
        answer.end = answered ? WebAnswer::End::answered : WebAnswer::End::failed;
        if (code == CURLE_PEER_FAILED_VERIFICATION) {
            answer.end = WebAnswer::End::badCertificate;
            answer.fault = fault();
        }
        answer.steps = steps(code == CURLE_OK);
        answer.clockOffset = clockOffset();
        if (!answered) answer.why = curl_easy_strerror(code);
        return answer;
    }

  private:
    template <class T>
    void set(CURLoption option, T value) {
        curl_easy_setopt(easy_.get(), option, value);
    }

    static void append(List& list, const std::string& text) {
        curl_slist* longer = curl_slist_append(list.get(), text.c_str());
        if (longer == nullptr) return;
        (void)list.release();
        list.reset(longer);
    }

    /// The folder of the system's certificates lets the few that are needed be read, the file all of them.
    void setAuthorities() {
        if (request_.authorities.empty()) {
            set(CURLOPT_CAPATH, "/etc/ssl/certs");
            curl_easy_setopt(easy_.get(), CURLOPT_CAINFO, nullptr);
        } else {
            set(CURLOPT_CAINFO, request_.authorities.c_str());
            curl_easy_setopt(easy_.get(), CURLOPT_CAPATH, nullptr);
        }
    }

    void setAddresses() {
        if (request_.addresses.empty()) return;
        std::string entry =
            hostOf(request_.url) + ":" + partOf(request_.url, {CURLUPART_PORT, CURLU_DEFAULT_PORT});
        char separator = ':';
        for (const IPAddress& address : request_.addresses) {
            entry += separator + (address.isIPv4() ? address.text() : "[" + address.text() + "]");
            separator = ',';
        }
        append(addresses_, entry);
        set(CURLOPT_RESOLVE, addresses_.get());
    }

    std::string info(CURLINFO which) const {
        const char* text = nullptr;
        curl_easy_getinfo(easy_.get(), which, &text);
        return text != nullptr ? plainText(text, 2048) : std::string();
    }

    /// The moment of a step in ms since the beginning; 0 where it was not reached.
    double moment(CURLINFO which) const {
        curl_off_t microseconds = 0;
        curl_easy_getinfo(easy_.get(), which, &microseconds);
        return static_cast<double>(microseconds) / 1000.0;
    }

    ContactSteps steps(bool complete) const {
        const double connected = moment(CURLINFO_CONNECT_TIME_T),
                     secured = moment(CURLINFO_APPCONNECT_TIME_T),
                     asked = moment(CURLINFO_PRETRANSFER_TIME_T),
                     answered = moment(CURLINFO_STARTTRANSFER_TIME_T);
        ContactSteps steps;
        if (connected > 0) steps.connect = connected - moment(CURLINFO_NAMELOOKUP_TIME_T);
        if (secured > connected) steps.secure = secured - connected;
        if (complete && !request_.connectOnly && answered > asked) steps.firstByte = answered - asked;
        return steps;
    }

    CertificateFault fault() const {
        long code = 0;
        curl_easy_getinfo(easy_.get(), CURLINFO_SSL_VERIFYRESULT, &code);
        return faultOfCode(code);
    }

    std::optional<std::int64_t> clockOffset() const {
        curl_header* date = nullptr;
        if (curl_easy_header(easy_.get(), "Date", 0, CURLH_HEADER, -1, &date) != CURLHE_OK)
            return std::nullopt;
        const std::time_t server = curl_getdate(date->value, nullptr);
        if (server == -1) return std::nullopt;
        return std::int64_t{std::time(nullptr)} - std::int64_t{server};
    }

    static std::size_t take(char* data, std::size_t, std::size_t size, void* self) {
        auto& transfer = *static_cast<Transfer*>(self);
        const std::size_t room = transfer.request_.longestBody - transfer.body_.size();
        transfer.body_.append(data, std::min(size, room));
        return size > room ? 0 : size;
    }

    const WebRequest& request_;
    Easy easy_;
    List headers_;
    List addresses_;
    std::string body_;
};

using Transfers = std::vector<std::unique_ptr<Transfer>>;
using Answers = std::vector<std::optional<WebAnswer>>;

/// Takes what is finished out of the group; whether anything was.
bool collect(CURLM* multi, const Transfers& transfers, Answers& answers) {
    int waiting = 0;
    bool any = false;
    while (const CURLMsg* message = curl_multi_info_read(multi, &waiting)) {
        if (message->msg != CURLMSG_DONE) continue;
        for (std::size_t i = 0; i < transfers.size(); ++i) {
            if (transfers[i]->handle() != message->easy_handle || answers[i]) continue;
            answers[i] = transfers[i]->answer(message->data.result);
            any = true;
        }
    }
    return any;
}

bool complete(const Answers& answers) {
    return std::all_of(answers.begin(), answers.end(), [](const auto& each) { return each.has_value(); });
}

/// Turns the group until all are answered, what there is suffices, or time is over.
Wait turnAll(CURLM* multi, const Transfers& transfers, Answers& answers, const Until& until,
             const Conclusive& conclusive) {
    while (true) {
        int running = 0;
        if (curl_multi_perform(multi, &running) != CURLM_OK) return Wait::timeout;
        if (collect(multi, transfers, answers) && conclusive && conclusive(answers)) return Wait::ready;
        if (complete(answers)) return Wait::ready;
        if (until.stop->raised()) return Wait::stopped;
        const auto left = timeLeft(until);
        if (left.count() == 0) return Wait::timeout;
        curl_waitfd stop{until.stop->descriptor(), CURL_WAIT_POLLIN, 0};
        curl_multi_poll(multi, &stop, 1, static_cast<int>(std::min<std::int64_t>(left.count(), 1000)),
                        nullptr);
    }
}

WebAnswer failed(const char* why) {
    WebAnswer answer;
    answer.why = why;
    return answer;
}

/// The library would look a name up by itself, over any interface, and could not be stopped while it does.
bool needsName(const WebRequest& request) {
    return request.addresses.empty() && !IPAddress::fromText(hostOf(request.url));
}

}  // namespace

std::string hostOf(const std::string& url) {
    const std::string scheme = partOf(url, {CURLUPART_SCHEME});
    if (scheme != "http" && scheme != "https") return {};
    std::string host = partOf(url, {CURLUPART_HOST});
    if (host.starts_with("[") && host.ends_with("]")) host = host.substr(1, host.size() - 2);
    return host;
}

Known<std::vector<WebAnswer>> runWebRequests(const std::vector<WebRequest>& requests, const Until& until,
                                             const Conclusive& conclusive) {
    static const LibraryUser user;
    const Multi multi(curl_multi_init());
    Transfers transfers;
    Answers answers(requests.size());
    for (const WebRequest& request : requests) {
        transfers.push_back(std::make_unique<Transfer>(request));
        if (needsName(request))
            answers[transfers.size() - 1] = failed("the name of its host has no address");
        else
            curl_multi_add_handle(multi.get(), transfers.back()->handle());
    }
    const Wait wait = turnAll(multi.get(), transfers, answers, until, conclusive);
    for (const auto& transfer : transfers) curl_multi_remove_handle(multi.get(), transfer->handle());
    if (wait == Wait::stopped) return waitFailure(wait, "the web");
    std::vector<WebAnswer> all;
    for (auto& answer : answers) {
        const char* why = wait == Wait::ready ? "not waited for any longer" : "no answer in time";
        all.push_back(answer ? std::move(*answer) : failed(why));
    }
    return all;
}

}  // namespace wp
