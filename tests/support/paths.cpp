#include "support/paths.h"

const std::string& binFolder() {
    static const std::string path = OVPHOTO_BIN_DIR;
    return path;
}

const std::string& sourceFolder() {
    static const std::string path = OVPHOTO_SOURCE_DIR;
    return path;
}

const std::string& modulePath() {
    static const std::string path = OVPHOTO_MODULE;
    return path;
}

const std::string& hostPath() {
    static const std::string path = OVPHOTO_HOST;
    return path;
}
