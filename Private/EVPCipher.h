// EVPCipher: symmetric encryption of setting values with the OpenSSL EVP ciphers.
//
// A password is the text encoding of key-length random bytes; the key is those bytes and the IV
// is derived from the key. Cipher text is the text encoding of the encrypted bytes (standard
// PKCS#7 padding). The text encoding writes every byte as two characters of a fixed
// 16-character alphabet, high four bits first.
//
// The alphabet and the two IV constants (EVPCipher.cpp) are part of every encrypted value ever
// written: they can never change.
#ifndef EVPCIPHER_H
#define EVPCIPHER_H

#include "VLString.h"

class EVPCipher {
 public:
  // The stored values are the algorithm numbers of the settings files: never renumber.
  enum ALGO {
    BLOWFISH_CBC = 0,
    AES_128_CBC = 1,  // the settings files' cipher
  };

  // BLOWFISH_CBC selects Blowfish-CBC (from OpenSSL's legacy provider: without it installed,
  // every Blowfish operation fails); any other value AES-128-CBC.
  explicit EVPCipher(ALGO algo);
  ~EVPCipher();
  EVPCipher(const EVPCipher&) = delete;
  EVPCipher& operator=(const EVPCipher&) = delete;

  // Length in characters of a password of this cipher: twice its key length.
  unsigned PasswordLength() const;
  // A new random password; empty when the random generator failed.
  VLString GeneratePswd();
  // Sets key and IV from password. False when the password is not the text encoding of exactly
  // key-length bytes.
  bool GenerateKeyIV(const VLString& password);
  // The text-encoded cipher text of plain; empty when plain or password is empty, the password
  // is not one of this cipher, or the cipher failed.
  VLString Encrypt(const VLString& plain, const VLString& password);
  // The plain text up to its first 0 byte; empty when an input is empty, the password is not one
  // of this cipher, the cipher text is not in the text encoding, or decryption failed (which
  // includes bad padding, the usual sign of a wrong password or damaged cipher text).
  VLString Decrypt(const VLString& cipherText, const VLString& password);

  // The 2n-character text encoding of n bytes.
  static VLString SimpleEncode(const unsigned char* bytes, unsigned n);
  // Decodes text into out. With a null out only the size is reported: n = text length / 2, and
  // the result tells whether that length is even. Otherwise n is out's capacity on entry and the
  // decoded byte count on return; false (out's content undefined) when the length is odd, a
  // character is outside the alphabet, or out is too small.
  static bool SimpleDecode(const VLString& text, unsigned char* out, unsigned& n);

 private:
  struct Impl;

  // One pass of the cipher over n bytes with the current key and IV; false on any failure.
  bool Run(bool encrypt, const unsigned char* in, unsigned n, unsigned char* out, unsigned& outLen);

  Impl* m_Impl;
};

#endif  // EVPCIPHER_H
