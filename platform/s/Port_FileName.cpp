// Names are texts in three parts: directory, base, extension. The disk is not asked, but for the
// current directory.

#include "Port_FileName.h"

#include <algorithm>
#include <filesystem>
#include <utility>

namespace Port {

namespace {

using String = StringBase<char>;

constexpr char kSeparator = '/';

bool IsAbsolute(std::string_view path) { return !path.empty() && path.front() == kSeparator; }

std::string_view WithoutLeading(std::string_view path) {
  return path.substr(std::min(path.find_first_not_of(kSeparator), path.size()));
}

std::string_view WithoutTrailing(std::string_view path) {
  return path.substr(0, path.find_last_not_of(kSeparator) + 1);
}

// A directory without the separators behind it, the root apart.
std::string_view Directory(std::string_view path) {
  const std::string_view directory = WithoutTrailing(path);
  return directory.empty() && IsAbsolute(path) ? path.substr(0, 1) : directory;
}

String Join(std::string_view directory, std::string_view component) {
  std::string path(directory);
  if (!directory.empty() && !component.empty() && directory.back() != kSeparator)
    path += kSeparator;
  return String(path += component);
}

// The text up to the last separator, that one included, and what stands behind it.
std::pair<std::string_view, std::string_view> SplitLast(std::string_view path) {
  const std::size_t tail = path.find_last_of(kSeparator) + 1;
  return {path.substr(0, tail), path.substr(tail)};
}

}  // namespace

FileName::FileName(const char* name) {
  const auto [directory, tail] = SplitLast(ToView(name));
  head = String(directory);
  Split(tail);
}

FileName::~FileName() = default;

void FileName::Split(std::string_view tail) {
  const std::size_t dot = tail.find_last_of('.');
  // A name that begins with its only dot has no extension, nor has one that ends in it.
  const bool extended = dot != std::string_view::npos && dot > 0 && dot + 1 < tail.size();
  base = String(tail.substr(0, extended ? dot : tail.size()));
  extension = String(extended ? tail.substr(dot + 1) : std::string_view());
}

String FileName::GetName() const { return Join(head.View(), GetTail().View()); }

String FileName::GetAbsolutePath(bool /*reserved*/) const {
  String name = GetName();
  // Steps and links stay as they are: callers compare these texts.
  if (IsAbsolute(name.View())) return name;
  return Join(std::filesystem::current_path().native(), name.View());
}

String FileName::GetHead(bool /*reserved1*/, bool /*reserved2*/) const {
  return String(Directory(head.View()));
}

String FileName::GetPath() const { return String(WithoutLeading(WithoutTrailing(head.View()))); }

String FileName::GetTail() const {
  String tail = base;
  if (HasExtension()) {
    tail.Append(".");
    tail.Append(extension);
  }
  return tail;
}

void FileName::SetHead(const char* directory) { head = directory; }

void FileName::SetTail(const char* tail) {
  const auto [levels, component] = SplitLast(ToView(tail));
  PushPathEnd(String(levels));
  Split(component);
}

void FileName::SetBase(const char* name) {
  base = name;
  extension.Empty();
}

void FileName::PushPathEnd(const char* levels) {
  head = Join(head.View(), WithoutLeading(WithoutTrailing(ToView(levels))));
}

String FileName::PopPathEnd() {
  const auto [rest, level] = SplitLast(WithoutTrailing(head.View()));
  // The root has no level to take off.
  if (level.empty()) return {};
  String popped(level);
  head = String(Directory(rest));
  return popped;
}

String FileName::Normalize(bool /*reserved*/) const {
  return String(std::filesystem::path(GetName().View()).lexically_normal().native());
}

}  // namespace Port
