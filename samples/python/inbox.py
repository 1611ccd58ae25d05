"""Lists an inbox folder, a line a message: python3 inbox.py [FOLDER]"""

import sys

import varnex3


def main(folder: str) -> int:
    messages = varnex3.Xalo_Messages()
    is_whole, number, words = messages.ParseFiles(folder)
    for i in range(messages.Count):
        message = messages.MessageItems(i)
        if message.ParseError:
            print(message.ErrorMessage)
        else:
            print(message.MessageNo, message.MessageDescription, message.Registration, message.ClaimNo, sep=", ")
    print(messages.Count, "messages")
    if not is_whole:
        print(f"Error {number}: {words}")
    return 0 if is_whole else 1


sys.exit(main(sys.argv[1] if len(sys.argv) > 1 else "samples/inbox"))
