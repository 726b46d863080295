#include "VLSimFaults.h"

#include <cstdlib>

#include "VLSimCertificates.h"

namespace {

struct ModeName {
  VLSimFault::Mode mode;
  const char* name;
  bool needsArg;
};

const ModeName kModes[] = {
    {VLSimFault::kDelay, "delay", true},         {VLSimFault::kClose, "close", false},
    {VLSimFault::kCut, "cut", false},            {VLSimFault::kStatus, "status", true},
    {VLSimFault::kSoapFault, "soapfault", false}, {VLSimFault::kCode, "code", true},
    {VLSimFault::kMalformed, "malformed", false}, {VLSimFault::kTruncated, "truncated", false},
    {VLSimFault::kGzip, "gzip", false},          {VLSimFault::kDeflate, "deflate", false},
    {VLSimFault::kBadLength, "badlength", false}, {VLSimFault::kTrickle, "trickle", true},
    {VLSimFault::kTls, "tls", true},
};

bool ParseInt(const std::string& text, int* value) {
  if (text.empty()) return false;
  char* end = nullptr;
  long number = strtol(text.c_str(), &end, 10);
  if (*end != '\0' || number < -1000000000L || number > 1000000000L) return false;
  *value = static_cast<int>(number);
  return true;
}

bool Matches(const VLSimFault& fault, const std::string& operation, const std::string& path) {
  if (fault.target == "*") return true;
  if (fault.target[0] == '/') return path.compare(0, fault.target.size(), fault.target) == 0;
  return fault.target == operation;
}

}  // namespace

bool VLSimFault::Parse(const std::string& spec, VLSimFault* fault, std::string* error) {
  *fault = VLSimFault();
  size_t equals = spec.find('=');
  if (equals == std::string::npos || equals == 0) {
    *error = "fault \"" + spec + "\": expected TARGET=MODE[:ARG][,times=N]";
    return false;
  }
  fault->target = spec.substr(0, equals);
  std::string rest = spec.substr(equals + 1);
  size_t comma = rest.find(',');
  if (comma != std::string::npos) {
    std::string option = rest.substr(comma + 1);
    rest.resize(comma);
    if (option.compare(0, 6, "times=") != 0 || !ParseInt(option.substr(6), &fault->times) || fault->times < 1) {
      *error = "fault \"" + spec + "\": expected times=N with N at least 1";
      return false;
    }
  }
  size_t colon = rest.find(':');
  std::string mode = rest.substr(0, colon);
  std::string arg = colon == std::string::npos ? std::string() : rest.substr(colon + 1);
  const ModeName* found = nullptr;
  for (const ModeName& entry : kModes)
    if (mode == entry.name) found = &entry;
  if (!found) {
    *error = "fault \"" + spec + "\": unknown mode \"" + mode + "\"";
    return false;
  }
  fault->mode = found->mode;
  if (found->needsArg && arg.empty()) {
    *error = "fault \"" + spec + "\": mode " + mode + " needs an argument";
    return false;
  }
  bool ok = true;
  switch (fault->mode) {
    case kTls:
      fault->text = arg;
      ok = VLSimCertificates::Parse(arg) != VLSimCertificates::kKindCount;
      break;
    case kSoapFault:
      fault->text = arg.empty() ? "server" : arg;
      ok = fault->text == "server" || fault->text == "client";
      break;
    case kBadLength:
      fault->arg = 64;
      ok = arg.empty() || (ParseInt(arg, &fault->arg) && fault->arg != 0);
      break;
    case kStatus:
      ok = ParseInt(arg, &fault->arg) && fault->arg >= 100 && fault->arg <= 599;
      break;
    case kDelay:
    case kTrickle:
      ok = ParseInt(arg, &fault->arg) && fault->arg >= 0;
      break;
    case kCode:
      ok = ParseInt(arg, &fault->arg);
      break;
    default:
      ok = arg.empty();
      break;
  }
  if (!ok) {
    *error = "fault \"" + spec + "\": bad argument \"" + arg + "\" for " + mode;
    return false;
  }
  return true;
}

std::string VLSimFault::ToString() const {
  std::string text = target + "=";
  for (const ModeName& entry : kModes)
    if (entry.mode == mode) text += entry.name;
  if (mode == kTls || mode == kSoapFault) text += ":" + this->text;
  else if (mode == kDelay || mode == kTrickle || mode == kStatus || mode == kCode || mode == kBadLength)
    text += ":" + std::to_string(arg);
  if (times > 0) text += ",times=" + std::to_string(times);
  return text;
}

void VLSimFaults::Add(const VLSimFault& fault) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  m_Faults.push_back(fault);
}

void VLSimFaults::Clear() {
  std::lock_guard<std::mutex> lock(m_Mutex);
  m_Faults.clear();
}

std::vector<VLSimFault> VLSimFaults::Take(const std::string& operation, const std::string& path) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  std::vector<VLSimFault> taken;
  for (size_t i = 0; i < m_Faults.size();) {
    VLSimFault& fault = m_Faults[i];
    if (fault.mode == VLSimFault::kTls || !Matches(fault, operation, path)) {
      ++i;
      continue;
    }
    taken.push_back(fault);
    if (fault.times > 0 && --fault.times == 0) m_Faults.erase(m_Faults.begin() + i);
    else ++i;
  }
  return taken;
}

bool VLSimFaults::TakeTls(const std::string& serverName, VLSimFault* fault) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  for (size_t i = 0; i < m_Faults.size(); ++i) {
    VLSimFault& candidate = m_Faults[i];
    if (candidate.mode != VLSimFault::kTls || (candidate.target != "*" && candidate.target != serverName)) continue;
    *fault = candidate;
    if (candidate.times > 0 && --candidate.times == 0) m_Faults.erase(m_Faults.begin() + i);
    return true;
  }
  return false;
}
