// Basic utilities: text copies and conversions, URL encoding, bounded formatting, time, hashing,
// random bytes and the device identifier.
#include "VLUtilities.h"

#include <net/if.h>
#include <netinet/in.h>
#include <openssl/rand.h>
#include <stdarg.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <strings.h>
#include <sys/ioctl.h>
#include <sys/socket.h>
#include <sys/time.h>
#include <unistd.h>

#include "VLAssert.h"

char* VLUtilities::StrDup(const char* s) {
  size_t n = s ? strlen(s) : 0;
  char* copy = new char[n + 1];
  if (n) memcpy(copy, s, n);
  copy[n] = 0;
  return copy;
}

bool VLUtilities::Str2Bool(const char* s) { return s && strcasecmp(s, "true") == 0; }

int VLUtilities::SortOrder2Int(VL_WS_SortOrder order) {
  switch (order) {
    case VL_WS_SORT_0:
    case VL_WS_SORT_1:
    case VL_WS_SORT_2:
    case VL_WS_SORT_3:
      return static_cast<int>(order);
  }
  return 0;
}

VLString VLUtilities::URLEncode(const char* s) {
  static const char kHex[] = "0123456789ABCDEF";
  VLString encoded;
  if (!s) return encoded;
  for (const unsigned char* p = reinterpret_cast<const unsigned char*>(s); *p; ++p) {
    unsigned char c = *p;
    bool plain = (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') ||
                 strchr("-_.!~*'()", c) != 0;
    if (plain) {
      encoded += static_cast<char>(c);
    } else {
      const char escape[3] = {'%', kHex[c >> 4], kHex[c & 0x0F]};
      encoded.append(escape, 3);
    }
  }
  return encoded;
}

char* VLUtilities::safe_snprintf(char* buf, size_t bufsize, const char* format, ...) {
  VL_ASSERT((buf != 0) && (format != 0) && (bufsize > 1));
  va_list args;
  va_start(args, format);
  int n = vsnprintf(buf, bufsize, format, args);
  va_end(args);
  if (n < 0) buf[0] = 0;  // an encoding error leaves no defined content
  return buf;
}

VLString VLUtilities::TM2Str(const tm& t) {
  char text[20];
  // strftime gives 0 when the text does not fit (a year beyond 9999): the result is then empty.
  size_t n = strftime(text, sizeof text, "%Y/%m/%d %H:%M:%S", &t);
  return VLString(text, n);
}

unsigned int VLUtilities::MillisecondTime() {
  struct timeval now;
  gettimeofday(&now, nullptr);
  return static_cast<unsigned int>(static_cast<unsigned long long>(now.tv_sec) * 1000u +
                                   static_cast<unsigned long long>(now.tv_usec) / 1000u);
}

unsigned int VLUtilities::Hash(unsigned int seed, const char* data, unsigned int len) {
  uint32_t h = seed;
  for (unsigned int i = 0; i < len; ++i) {
    h *= 16777619u;
    h ^= static_cast<unsigned char>(data[i]);
  }
  return h;
}

int VLUtilities::RandomBytes(char* buf, unsigned int n) {
  if (RAND_status() == 0) {
    srand(rand() + static_cast<unsigned>(time(nullptr)));
    unsigned char seed[128];
    for (unsigned char& b : seed) b = static_cast<unsigned char>(rand());
    RAND_seed(seed, sizeof seed);
  }
  return RAND_bytes(reinterpret_cast<unsigned char*>(buf), static_cast<int>(n));
}

namespace {

VLString FormatIdentifier(const unsigned char b0, const unsigned char b1, const unsigned char b2,
                          const unsigned char b3, const unsigned char b4, const unsigned char b5) {
  char text[18];
  snprintf(text, sizeof text, "%02X-%02X-%02X-%02X-%02X-%02X", b0, b1, b2, b3, b4, b5);
  return VLString(text);
}

// The first listed interface with a hardware address that is not all zero (loopback has none).
bool HardwareIdentifier(int fd, VLString* identifier) {
  alignas(struct ifreq) char listing[4096];
  struct ifconf conf;
  conf.ifc_len = sizeof listing;
  conf.ifc_buf = listing;
  if (ioctl(fd, SIOCGIFCONF, &conf) != 0) return false;
  const struct ifreq* entries = reinterpret_cast<const struct ifreq*>(listing);
  size_t count = static_cast<size_t>(conf.ifc_len) / sizeof(struct ifreq);
  for (size_t i = 0; i < count; ++i) {
    struct ifreq request;
    memset(&request, 0, sizeof request);
    memcpy(request.ifr_name, entries[i].ifr_name, IFNAMSIZ);
    if (ioctl(fd, SIOCGIFHWADDR, &request) != 0) continue;
    const unsigned char* a = reinterpret_cast<const unsigned char*>(request.ifr_hwaddr.sa_data);
    if ((a[0] | a[1] | a[2] | a[3] | a[4] | a[5]) == 0) continue;
    *identifier = FormatIdentifier(a[0], a[1], a[2], a[3], a[4], a[5]);
    return true;
  }
  return false;
}

}  // namespace

VLString VLUtilities::GetUniqueIdentifier() {
  VLString identifier;
  int fd = socket(AF_INET, SOCK_DGRAM, 0);
  bool found = fd >= 0 && HardwareIdentifier(fd, &identifier);
  if (fd >= 0) close(fd);
  if (found) return identifier;

  unsigned char r[24] = {0};
  RandomBytes(reinterpret_cast<char*>(r), sizeof r);
  return FormatIdentifier(r[0], r[4], r[8], r[12], r[16], r[20]);
}
