ovphoto_add_test(messageFile / messageFormat_test) ovphoto_add_test(messageFile / messageFile_test)
    ovphoto_add_test(messageFile / messageTexts_test)
        add_dependencies(messageFile_messageTexts_test ovphoto_messages)
