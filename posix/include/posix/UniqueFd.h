#pragma once
// An owned file descriptor: closed when the owner goes, so no return path
// can leak it.
namespace posix
{
class UniqueFd
{
public:
    UniqueFd() = default;
    explicit UniqueFd(int fd) : m_fd(fd) {}
    ~UniqueFd() { Reset(); }
    UniqueFd(UniqueFd&& other) noexcept : m_fd(other.Release()) {}
    UniqueFd& operator=(UniqueFd&& other) noexcept;
    UniqueFd(const UniqueFd&) = delete;
    UniqueFd& operator=(const UniqueFd&) = delete;

    int Get() const { return m_fd; }
    bool IsOpen() const { return m_fd >= 0; }
    explicit operator bool() const { return IsOpen(); }

    // Gives the descriptor up without closing it.
    int Release();
    // Closes the descriptor now, ignoring the result; takes fd instead.
    void Reset(int fd = -1);
    // Closes now and says whether close succeeded: a written file's last
    // error can show only here. errno is kept from close.
    bool Close();

private:
    int m_fd = -1;
};
} // namespace posix
