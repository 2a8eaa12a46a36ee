// What it takes the system to start and end any program.
int main() {}
