// BoxArtDownloader: fetches one box-art image from the store's image host (plain HTTP, port 80)
// with a hand-written HTTP/1.1 GET, optionally conditional on an earlier "Last-Modified" value,
// into memory or into a file. It lives on the stack of one client operation and uses the
// connection callbacks of that handle's catalogue context (VLTransportConnection); the caller
// decides about the context's HTTP proxy.
//
// The answer is read through one 2048-byte buffer: its whole header must fit into it (at most
// 2047 bytes, however many pieces it comes in); the body is then passed straight on to the file
// or the string.
//
// A download to a file writes a temporary file "vlws??????" beside the destination and renames
// it over the destination only when the image is complete, so the destination is always either
// the complete new image or what it was before, and no temporary file is left behind.
#ifndef BOXARTDOWNLOADER_H
#define BOXARTDOWNLOADER_H

#include "VLString.h"
#include "VL_WS_Records.h"
#include "stdsoap2.h"

class BoxArtDownloader {
 public:
  // The largest image accepted: a larger "Content-Length" is refused before anything is stored.
  static const unsigned int kMaxContentLength = 32u * 1024 * 1024;

  explicit BoxArtDownloader(soap* context);
  virtual ~BoxArtDownloader();
  BoxArtDownloader(const BoxArtDownloader&) = delete;
  BoxArtDownloader& operator=(const BoxArtDownloader&) = delete;

  // Downloads the image of prefix in size, sending "If-Modified-Since" when ifModifiedSince is
  // not empty. toFile false: target receives the image bytes; toFile true: target names the file
  // to write. Returns
  //   0      the image is complete in target;
  //   -2011  no connection to the image host;
  //   -1001  a send or receive failed, or the answer has not the expected form (no
  //          "Content-Length", a length below 1 or above kMaxContentLength, a header longer
  //          than 2047 bytes, an encoded body, an answer that ends early, a body that is
  //          no JPEG image);
  //   -1901  the server answered "404 Not Found";
  //   -1902  the server answered "304 Not Modified" (the stored image is current);
  //   -1900  the temporary file could not be made or written, or not renamed to target.
  // A body longer than its "Content-Length" is cut to that length.
  VL_WS_Status Download(const VLString& prefix, VL_WS_BoxArtSize size, const VLString& ifModifiedSince, bool toFile,
                        VLString& target);
  VL_WS_Status DownloadToBuffer(const VLString& prefix, VL_WS_BoxArtSize size, const VLString& ifModifiedSince,
                                VLString& data);
  VL_WS_Status DownloadToFile(const VLString& prefix, VL_WS_BoxArtSize size, const VLString& ifModifiedSince,
                              const VLString& filename);

  // "Content-Length" and "Last-Modified" (empty when absent) of the last successful download;
  // 0 and empty before one.
  unsigned int GetContentLength() const { return m_ContentLength; }
  VLString GetLastModified() const { return m_LastModified; }

 private:
  class Sink;
  // The exchange with the image host: the image's body goes to sink; length and lastModified
  // receive the answer's header values.
  VL_WS_Status Fetch(const VLString& prefix, VL_WS_BoxArtSize size, const VLString& ifModifiedSince, Sink& sink,
                     unsigned int* length, VLString* lastModified);

  soap* m_Soap;
  unsigned int m_ContentLength;
  VLString m_LastModified;
};

#endif  // BOXARTDOWNLOADER_H
