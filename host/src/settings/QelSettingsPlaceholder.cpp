// Replaced by the service's first source file.
