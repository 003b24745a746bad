#ifndef REPOSITORYBUILDER_H
#define REPOSITORYBUILDER_H

#include <filesystem>
#include <string>

// Builds a repository in a directory of its own, which goes away with the builder.
//
//     RepositoryBuilder repo;
//     repo.Core("abc_v1_00_a").Qvr("OPTION STYLE = MIX").Ldx("lib abc_v1_00_a a.vhd");
class RepositoryBuilder {
 public:
  // One version directory. Each operation gives the same core again.
  class CoreBuilder {
   public:
    CoreBuilder& Qvr(const std::string& text) { return Data("qvr", text); }
    CoreBuilder& Ldx(const std::string& text) { return Data("ldx", text); }
    CoreBuilder& Tew(const std::string& text) { return Data("tew", text); }
    // Any file below the version directory.
    CoreBuilder& File(const std::string& name, const std::string& text);

    std::string Location() const { return directory; }

   private:
    friend class RepositoryBuilder;
    explicit CoreBuilder(std::filesystem::path location) : directory(std::move(location)) {}
    CoreBuilder& Data(const std::string& extension, const std::string& text);

    std::filesystem::path directory;
  };

  RepositoryBuilder();
  ~RepositoryBuilder();
  RepositoryBuilder(const RepositoryBuilder&) = delete;
  RepositoryBuilder& operator=(const RepositoryBuilder&) = delete;

  CoreBuilder Core(const std::string& key);
  // A file below the repository.
  void File(const std::string& name, const std::string& text);

  std::string Path() const { return root; }
  std::string operator/(const std::string& name) const { return root / name; }

 private:
  std::filesystem::path root;
};

#endif
