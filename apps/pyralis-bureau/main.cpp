// pyralis-bureau: the desktop host (being built).
int main() {
    return 0;
}
