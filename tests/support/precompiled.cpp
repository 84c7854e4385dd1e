// Only its precompiled headers are of use.

int main() { return 0; }
