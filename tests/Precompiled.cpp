// A program for the precompiled headers to belong to.
int main() {}
