#include "VLJsonWriter.h"

#include <stdio.h>
#include <string.h>

void VLJsonWriter::Key(const char* name) {
  StartValue();
  Quote(name, strlen(name));
  m_Out += ": ";
  m_AfterKey = true;
}

void VLJsonWriter::Int(long long value) {
  StartValue();
  m_Out += std::to_string(value);
}

void VLJsonWriter::Bool(bool value) {
  StartValue();
  m_Out += value ? "true" : "false";
}

void VLJsonWriter::String(const char* text) {
  if (!text) {
    StartValue();
    m_Out += "null";
    return;
  }
  String(text, strlen(text));
}

void VLJsonWriter::String(const char* bytes, size_t length) {
  StartValue();
  Quote(bytes, length);
}

void VLJsonWriter::Quote(const char* bytes, size_t length) {
  m_Out += '"';
  for (size_t i = 0; i < length; ++i) {
    unsigned char c = static_cast<unsigned char>(bytes[i]);
    switch (c) {
      case '"': m_Out += "\\\""; break;
      case '\\': m_Out += "\\\\"; break;
      case '\n': m_Out += "\\n"; break;
      case '\r': m_Out += "\\r"; break;
      case '\t': m_Out += "\\t"; break;
      default:
        if (c < 0x20) {
          char escaped[8];
          snprintf(escaped, sizeof escaped, "\\u%04x", c);
          m_Out += escaped;
        } else {
          m_Out += static_cast<char>(c);
        }
    }
  }
  m_Out += '"';
}

void VLJsonWriter::Begin(char bracket) {
  StartValue();
  m_Out += bracket;
  ++m_Depth;
  m_Empty = true;
}

void VLJsonWriter::End(char bracket) {
  --m_Depth;
  if (!m_Empty) NewLine();
  m_Out += bracket;
  m_Empty = false;
  if (m_Depth == 0) m_Out += '\n';
}

void VLJsonWriter::StartValue() {
  if (m_AfterKey) {
    m_AfterKey = false;
    return;
  }
  if (m_Depth == 0) return;
  if (!m_Empty) m_Out += ',';
  NewLine();
  m_Empty = false;
}

void VLJsonWriter::NewLine() {
  m_Out += '\n';
  m_Out.append(2 * static_cast<size_t>(m_Depth), ' ');
}
