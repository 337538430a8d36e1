// Prints the system's words for an error, which differ between versions and languages of Windows.

#include <windows.h>

#include <cstdlib>
#include <iostream>
#include <string>

int main(int argc, char** argv) {
  if (argc != 2) return 2;
  char buffer[1024];
  const DWORD length = FormatMessageA(FORMAT_MESSAGE_FROM_SYSTEM | FORMAT_MESSAGE_IGNORE_INSERTS, nullptr,
                                      std::strtoul(argv[1], nullptr, 10), 0, buffer, sizeof buffer, nullptr);
  const std::string text(buffer, length);
  std::cout << text.substr(0, text.find_last_not_of("\r\n ") + 1) << '\n';
  return text.empty() ? 1 : 0;
}
