#include "EVPCipher.h"

#include <limits.h>
#include <openssl/err.h>
#include <openssl/evp.h>
#include <openssl/provider.h>
#include <string.h>

#include <vector>

#include "VLAssert.h"
#include "VLUtilities.h"

namespace {

// Fixed forever: every encrypted value on every device was written with these (see header).
const char kAlphabet[] = "0123456789abcdef";
const unsigned char kIVFill = 0x5C;  // IV bytes beyond the key's length
const unsigned char kIVMask = 0xB7;  // IV byte i = key byte i AND this

int AlphabetIndex(char c) {
  const char* p = static_cast<const char*>(memchr(kAlphabet, c, 16));
  return p ? static_cast<int>(p - kAlphabet) : -1;
}

// OpenSSL 3 keeps Blowfish in its legacy provider. It is loaded, with the default provider, into
// a library context of our own, once per process on first use, so that the host's own use of
// OpenSSL sees no change. Everything is released at exit, before OpenSSL's own clean-up.
class BlowfishProvider {
 public:
  BlowfishProvider()
      : m_Context(OSSL_LIB_CTX_new()), m_Default(NULL), m_Legacy(NULL), m_Cipher(NULL) {
    if (!m_Context) return;
    m_Default = OSSL_PROVIDER_load(m_Context, "default");
    m_Legacy = OSSL_PROVIDER_load(m_Context, "legacy");
    m_Cipher = EVP_CIPHER_fetch(m_Context, "BF-CBC", NULL);
  }
  ~BlowfishProvider() {
    EVP_CIPHER_free(m_Cipher);
    if (m_Legacy) OSSL_PROVIDER_unload(m_Legacy);
    if (m_Default) OSSL_PROVIDER_unload(m_Default);
    OSSL_LIB_CTX_free(m_Context);
  }
  BlowfishProvider(const BlowfishProvider&) = delete;
  BlowfishProvider& operator=(const BlowfishProvider&) = delete;

  // Null when the legacy provider is not installed.
  const EVP_CIPHER* Cipher() const { return m_Cipher; }

 private:
  OSSL_LIB_CTX* m_Context;
  OSSL_PROVIDER* m_Default;
  OSSL_PROVIDER* m_Legacy;
  EVP_CIPHER* m_Cipher;
};

const EVP_CIPHER* Blowfish() {
  static BlowfishProvider provider;
  return provider.Cipher();
}

}  // namespace

struct EVPCipher::Impl {
  EVP_CIPHER_CTX* ctx;
  const EVP_CIPHER* cipher;
  unsigned key_len;
  unsigned iv_len;
  unsigned block_size;
  std::vector<unsigned char> key;
  std::vector<unsigned char> iv;
};

EVPCipher::EVPCipher(ALGO algo) : m_Impl(new Impl) {
  m_Impl->ctx = EVP_CIPHER_CTX_new();
  m_Impl->cipher = algo == BLOWFISH_CBC ? Blowfish() : EVP_aes_128_cbc();
  // Without a cipher every size is 0: no password fits, and every Encrypt and Decrypt fails.
  m_Impl->key_len = m_Impl->cipher ? EVP_CIPHER_key_length(m_Impl->cipher) : 0;
  m_Impl->iv_len = m_Impl->cipher ? EVP_CIPHER_iv_length(m_Impl->cipher) : 0;
  m_Impl->block_size = m_Impl->cipher ? EVP_CIPHER_block_size(m_Impl->cipher) : 0;
  m_Impl->key.resize(m_Impl->key_len);
  m_Impl->iv.resize(m_Impl->iv_len);
}

EVPCipher::~EVPCipher() {
  EVP_CIPHER_CTX_free(m_Impl->ctx);
  delete m_Impl;
}

unsigned EVPCipher::PasswordLength() const { return 2 * m_Impl->key_len; }

VLString EVPCipher::GeneratePswd() {
  char buf[128];
  VL_ASSERT(sizeof(buf) >= m_Impl->key_len);
  if (VLUtilities::RandomBytes(buf, m_Impl->key_len) != 1) return VLString();
  return SimpleEncode(reinterpret_cast<unsigned char*>(buf), m_Impl->key_len);
}

bool EVPCipher::GenerateKeyIV(const VLString& password) {
  unsigned n = m_Impl->key_len;
  if (!SimpleDecode(password, m_Impl->key.data(), n) || n != m_Impl->key_len) return false;
  for (unsigned i = 0; i < m_Impl->iv_len; ++i) {
    m_Impl->iv[i] = i < m_Impl->key_len ? (m_Impl->key[i] & kIVMask) : kIVFill;
  }
  return true;
}

bool EVPCipher::Run(bool encrypt, const unsigned char* in, unsigned n, unsigned char* out,
                    unsigned& outLen) {
  int updated = 0, finished = 0;
  if (!m_Impl->ctx || !m_Impl->cipher || n > INT_MAX - m_Impl->block_size) return false;
  if (EVP_CipherInit_ex(m_Impl->ctx, m_Impl->cipher, NULL, m_Impl->key.data(), m_Impl->iv.data(),
                        encrypt ? 1 : 0) != 1 ||
      EVP_CipherUpdate(m_Impl->ctx, out, &updated, in, static_cast<int>(n)) != 1 ||
      EVP_CipherFinal_ex(m_Impl->ctx, out + updated, &finished) != 1) {
    // A wrong password is an expected failure: leave no error in this thread's OpenSSL queue,
    // where a later TLS call would take it for its own.
    ERR_clear_error();
    return false;
  }
  outLen = static_cast<unsigned>(updated + finished);
  return true;
}

VLString EVPCipher::Encrypt(const VLString& plain, const VLString& password) {
  if (plain.empty() || password.empty() || !GenerateKeyIV(password)) return VLString();
  if (plain.length() > UINT_MAX / 2 - m_Impl->block_size) return VLString();
  unsigned n = static_cast<unsigned>(plain.length());
  std::vector<unsigned char> out(n + m_Impl->block_size);
  unsigned outLen = 0;
  if (!Run(true, reinterpret_cast<const unsigned char*>(plain.c_str()), n, out.data(), outLen)) {
    return VLString();
  }
  return SimpleEncode(out.data(), outLen);
}

VLString EVPCipher::Decrypt(const VLString& cipherText, const VLString& password) {
  if (cipherText.empty() || password.empty() || !GenerateKeyIV(password)) return VLString();
  unsigned n = 0;
  if (!SimpleDecode(cipherText, NULL, n)) return VLString();
  std::vector<unsigned char> in(n);
  if (!SimpleDecode(cipherText, in.data(), n)) return VLString();
  std::vector<unsigned char> out(n + m_Impl->block_size);
  unsigned outLen = 0;
  if (!Run(false, in.data(), n, out.data(), outLen)) return VLString();
  const char* text = reinterpret_cast<const char*>(out.data());
  return VLString(text, strnlen(text, outLen));
}

VLString EVPCipher::SimpleEncode(const unsigned char* bytes, unsigned n) {
  if (n == 0) return VLString();
  std::vector<char> chars(2 * static_cast<size_t>(n));
  for (unsigned i = 0; i < n; ++i) {
    chars[2 * i] = kAlphabet[bytes[i] >> 4];
    chars[2 * i + 1] = kAlphabet[bytes[i] & 0x0F];
  }
  return VLString(chars.data(), chars.size());
}

bool EVPCipher::SimpleDecode(const VLString& text, unsigned char* out, unsigned& n) {
  size_t length = text.length();
  if (length / 2 > UINT_MAX) return false;
  unsigned needed = static_cast<unsigned>(length / 2);
  if (!out) {
    n = needed;
    return length % 2 == 0;
  }
  if (length % 2 != 0 || needed > n) return false;
  for (unsigned i = 0; i < needed; ++i) {
    int high = AlphabetIndex(text[2 * i]);
    int low = AlphabetIndex(text[2 * i + 1]);
    if (high < 0 || low < 0) return false;
    out[i] = static_cast<unsigned char>(high << 4 | low);
  }
  n = needed;
  return true;
}
