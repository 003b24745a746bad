#include <iostream>
#include <memory>

#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"

int main() {
  Tarvo::KelLibrary library;
  if (!library.SetRepositoryPath("examples/overlay;examples/repository")) return 1;
  const std::unique_ptr<Tarvo::KelIP> ip(library.CreateIP("pulse_counter"));
  Tarvo::StringList ports;
  if (!ip || !ip->ListPorts(ports)) return 1;
  std::cout << ip->GetLocation() << '\n';
  for (const auto& port : ports) std::cout << "  " << port << '\n';
}
