// Begins a product: a folder with a product file that packs as it is.
#pragma once

#include <string>
#include <vector>

// Makes the folder (UTF-8 path), which must not be there; its last part is the product's name. Returns the paths of the
// files made. Throws OrbitError, and then leaves no folder behind.
std::vector<std::string> NewProduct(const std::string& folder);
