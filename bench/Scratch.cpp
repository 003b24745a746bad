#include "Scratch.h"

#include <cstdlib>
#include <fstream>
#include <stdexcept>

namespace Scratch {

namespace fs = std::filesystem;

namespace {

// The directory for all that this program makes.
class Home {
 public:
  Home() {
    if (const char* const given = std::getenv("KEL_BENCH_DIRECTORY")) {
      path = given;
      return;
    }
    std::string pattern = fs::temp_directory_path() / "kel-bench-XXXXXX";
    if (!::mkdtemp(pattern.data())) throw std::runtime_error("cannot make " + pattern);
    path = pattern;
    temporary = true;
  }
  ~Home() {
    if (temporary) fs::remove_all(path);
  }
  Home(const Home&) = delete;
  Home& operator=(const Home&) = delete;

  const fs::path& Path() const { return path; }

 private:
  fs::path path;
  bool temporary = false;
};

}  // namespace

// Made under another name first, so that what was left half done is not taken for whole.
fs::path Prepare(const std::string& name, const std::function<void(const fs::path&)>& make) {
  static const Home home;
  fs::path path = home.Path() / name;
  if (fs::exists(path)) return path;
  const fs::path unfinished = home.Path() / (name + ".unfinished");
  fs::remove_all(unfinished);
  make(unfinished);
  fs::rename(unfinished, path);
  return path;
}

void WriteDataFile(const fs::path& repository, const std::string& core,
                   const std::string& extension, const std::string& text) {
  const fs::path data = repository / "ipmods" / (core + "_v1_00_a") / "data";
  fs::create_directories(data);
  std::ofstream file(data / (core + "_v2_1_0." + extension));
  if (!(file << text)) throw std::runtime_error("cannot write below " + data.native());
}

std::string Description() {
  std::string text =
      "# a generated core\nOPTION DESC = Generated core for measurements\nOPTION HDL = VHDL\n"
      "OPTION STYLE = MIX\nOPTION IP_GROUP = Measurement\nOPTION IPTYPE = BLOCK\n"
      "OPTION CORE_STATE = ACTIVE\n\nBUS_INTERFACE BUS = REGS, BUS_TYPE = SLAVE\n";
  for (int i = 0; i < 30; ++i) {
    const std::string number = std::to_string(i);
    text += "PARAMETER WIDTH_" + number + " = 8, DT = integer, RANGE = (2:32), DESC = \"Width\"\n";
  }
  for (int i = 0; i < 100; ++i) {
    const std::string number = std::to_string(i);
    text.append("PORT data_").append(number).append(" = DATA_").append(number);
    text += ",\tDIR = I, VEC = [31:0], BUS = REGS, DESC = \"Data\" # port\n";
  }
  return text;
}

}  // namespace Scratch
