#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace wp {

/// An answer of HTTP/1.x, read as its bytes come (RFC 9112). It is bounded whatever a server sends: lines of 16 KiB,
/// 64 KiB before the body, a few interim answers, and the body up to its own bound. A page that stands in for another is
/// often served by something home-made: lines that are no header are passed over, and a length that makes no sense, or
/// of which there are two, counts as none. Owner's thread.
class HttpAnswer {
  public:
    explicit HttpAnswer(std::size_t longestBody) : longestBody_(longestBody) {}

    /// Takes in what has arrived; whatever follows the end of the answer is left out.
    void take(std::string_view bytes);
    /// The server has ended the connection in order, which ends a body without a length too.
    void close();
    /// The connection has ended in no order: a body without a length is not known to be whole (RFC 9112, 8).
    void breakOff();

    /// Whether nothing more is waited for: the answer is whole, its body has reached the bound, or it is broken.
    bool ended() const { return part_ == Part::end || part_ == Part::broken; }
    /// Whether status and headers are there; the body may still be cut short.
    bool hasHead() const { return hasHead_; }
    /// Whether the body is there, as far as it is read at all, and did not break off.
    bool isWhole() const { return part_ == Part::end; }

    int status() const { return hasHead_ ? status_ : 0; }
    /// The value of the first header of that name, whose case plays no part; empty where there is none.
    std::string_view header(std::string_view name) const;
    const std::string& body() const { return body_; }

  private:
    enum class Part { statusLine, header, chunkSize, chunk, chunkEnd, counted, untilClosed, end, broken };

    std::optional<std::string_view> takeLine(std::string_view& bytes);
    void takeStatusLine(std::string_view line);
    void takeHeader(std::string_view line);
    void takeChunkSize(std::string_view line);
    void takeBody(std::string_view& bytes);
    void endHead();
    void chooseBody();
    std::string all(std::string_view name) const;

    std::size_t longestBody_;
    Part part_ = Part::statusLine;
    bool hasHead_ = false;
    int status_ = 0;
    int interim_ = 0;
    std::size_t headSize_ = 0;
    std::uint64_t left_ = 0;  ///< of a chunk or a counted body
    std::string line_;        ///< the beginning of one that is not whole yet
    std::string whole_;       ///< what the last whole line lies in
    std::vector<std::pair<std::string, std::string>> headers_;
    std::string body_;
};

/// The moment that a "Date" header names, in any of the three forms of RFC 9110, in seconds since 1970.
/// *Any* thread.
std::optional<std::int64_t> httpDate(std::string_view text);

}  // namespace wp
