// tavro-inventory-check FILE: says in one line what keeps a file from being an inventory, and exits with 1;
// with 0, if nothing does, and with 2 for another command line. cimhost calls it for --inventory.

#include "InventoryReader.h"
#include "ReadFile.h"

#include <cstddef>
#include <exception>
#include <iostream>

int main(int argc, char* argv[])
{
    constexpr std::size_t mostOfAFile = 64UL * 1024 * 1024; // as much as the library reads
    if (argc != 2) {
        std::cerr << "usage: tavro-inventory-check FILE\n";
        return 2;
    }
    try {
        Tavro::readInventory(Tavro::readFile(argv[1], mostOfAFile));
        return 0;
    } catch (const std::exception& error) {
        std::cout << error.what() << '\n';
        return 1;
    }
}
