"""The session's prompt as a person meets it at a terminal: Ctrl-C abandons the line being
typed and answers no at a question, Ctrl-D ends the session with a newline, and the lines
typed come back in the next session from the history file in the settings folder."""
import os
import pty
import select
import shutil
import sys
import time

program, settings = sys.argv[1], sys.argv[2]
shutil.rmtree(settings, ignore_errors=True)


def start():
    pid, fd = pty.fork()
    if pid == 0:
        os.environ['QEL_SETTINGS_DIR'] = settings
        os.execv(program, [program])
    return pid, fd


def read_until(fd, marker, seconds=20):
    out = b''
    end = time.time() + seconds
    while time.time() < end and marker not in out:
        ready, _, _ = select.select([fd], [], [], 0.1)
        if ready:
            try:
                out += os.read(fd, 65536)
            except OSError:
                break
    return out


def key(fd, byte):
    # A person presses a key once the prompt is up; on a loaded machine the program may
    # print the prompt a little before it reads.
    time.sleep(0.3)
    os.write(fd, byte)


def wait(pid, seconds=30):
    end = time.time() + seconds
    while time.time() < end:
        done, status = os.waitpid(pid, os.WNOHANG)
        if done:
            return status
        time.sleep(0.05)
    os.kill(pid, 9)
    return -1


def fail(message, seen):
    sys.stdout.flush()
    print(f'FAIL: {message}\n{seen!r}')
    sys.exit(1)


pid, fd = start()
read_until(fd, b'qelhost> ')
os.write(fd, b'tick "Annotation Sets/No')
time.sleep(0.3)
os.write(fd, b'\x03')
seen = read_until(fd, b'qelhost> ')
if b'done' in seen or b'hidden' in seen:
    fail('Ctrl-C ran the half-typed line', seen)
os.write(fd, b'tick "Annotation Sets/All sets"\r')
seen = read_until(fd, b'yes/no? ')
key(fd, b'\x03')
seen = read_until(fd, b'qelhost> ')
if b'refused' not in seen:
    fail('Ctrl-C at the question did not answer no', seen)
key(fd, b'\x04')
seen = read_until(fd, b'unloaded')
status = wait(pid)
if status != 0 or b'^D\r\n' not in seen and b'\r\nplug-in' not in seen:
    fail(f'Ctrl-D did not end the session cleanly (status {status})', seen)
history = open(os.path.join(settings, 'qelhost_history')).read()
if 'All\\040sets' not in history and 'All sets' not in history:
    fail('the line typed is not in the history file', history)
print('prompt keys: ok')
